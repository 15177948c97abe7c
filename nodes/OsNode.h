#ifndef NODES_OSNODE_H
#define NODES_OSNODE_H

#include "host/MutableNode.h"

namespace IC
{

/** The operating system: memory, swap and process figures are live, all else is stored. */
class OsNode : public MutableNode
{
public:
    OsNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
           unsigned int nodeType, unsigned int index);
    ~OsNode() override;

    /** A live figure that cannot be read leaves value unchanged and still succeeds. */
    Error getProperty(unsigned int id, PropertyValue& value) const override;

    /**
     * Stores the value, and acts on the system first if the property is a command: requested
     * state, clear log, refresh and create user. Only a create-user text that fails yields status
     * 1 and is not stored; an empty text is then stored in its place.
     */
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;
};

} // namespace IC

#endif
