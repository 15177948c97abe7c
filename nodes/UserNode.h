#ifndef NODES_USERNODE_H
#define NODES_USERNODE_H

#include "host/MutableNode.h"

namespace IC
{

/** A local user account. */
class UserNode : public MutableNode
{
public:
    UserNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
             unsigned int nodeType, unsigned int index);
    ~UserNode() override;

    Error getProperty(unsigned int id, PropertyValue& value) const override;
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;
};

} // namespace IC

#endif
