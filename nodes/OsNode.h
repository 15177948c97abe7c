#ifndef NODES_OSNODE_H
#define NODES_OSNODE_H

#include "host/MutableNode.h"

namespace IC
{

/**
 * The operating system. Physical memory, swap and the number of processes are read live, the
 * command to clear the log always reads as 0, and all else is stored.
 */
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
     * state, clear log, refresh and create user. Contract: only a create-user text that fails
     * yields status 1; an empty text is stored in its place. Other commands hide their failures.
     */
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;
};

} // namespace IC

#endif
