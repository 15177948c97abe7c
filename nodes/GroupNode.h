#ifndef NODES_GROUPNODE_H
#define NODES_GROUPNODE_H

#include "host/MutableNode.h"

namespace IC
{

/** A local group. */
class GroupNode : public MutableNode
{
public:
    GroupNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
              unsigned int nodeType, unsigned int index);
    ~GroupNode() override;

    Error getProperty(unsigned int id, PropertyValue& value) const override;
};

} // namespace IC

#endif
