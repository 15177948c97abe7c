#include "nodes/GroupNode.h"

#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"
#include "sysdata/groupInfo_linux.h"
#include "util/MutexLock.h"

namespace IC
{

using NQ::groupInfo;

GroupNode::GroupNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                     unsigned int nodeType, unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::log::entry(OSSWMI::unit, "GroupNode::GroupNode");
}

GroupNode::~GroupNode()
{
    NQ::log::lastEntry(OSSWMI::unit, "GroupNode::~GroupNode");
}

Error GroupNode::getProperty(unsigned int id, PropertyValue& value) const
{
    NQ::log::Scope const scope(OSSWMI::unit, {"GroupNode::getProperty"});
    if (id != property::elementCount)
        return MutableNode::getProperty(id, value);
    std::vector<groupInfo> groups;
    NQ::getGroupInfo(groups);
    value = values::number(static_cast<unsigned int>(groups.size()));
    return {0, Number(0U), ""}; // Contract: elsewhere the code is empty
}

void OsSwMI::createGroupNodes(bool refresh)
{
    NQ::log::Scope const scope(OSSWMI::unit);
    NQ::MutexLock const lock(OSSWMI::myuserlock);
    if (refresh)
        deleteNodes(groupNodes_, "Delete a group entry: ", scope);
    else
        groupNodes_.clear(); // owned by the framework from now on
    std::vector<groupInfo> groups;
    NQ::getGroupInfo(groups);
    auto const count = static_cast<unsigned int>(groups.size());
    scope.progress("groups.size() = ", count);
    groupNodes_.reserve(count);
    unsigned int position = 0;
    for (groupInfo& group : groups) {
        unsigned int const nodeId = refresh ? takeUnnotedNodeId() : takeNodeId();
        MutableNode* const node =
            adopt(std::make_unique<GroupNode>(nodeId, osNode_->getNodeId(), miIds_, nodeType::group,
                                              ++position),
                  &groupNodes_);
        setUp("Group");
        std::string const name = group.getGroupName();
        unsigned int const id = group.getGroupId();
        scope.progress("Name = ", name);
        scope.progress("Id = ", id);
        values::setProperties(*node, {{property::name, values::text(name)},
                                      {property::id, values::number(id)},
                                      {property::members, values::texts(group.getGroupMembers())},
                                      {property::elementCount, values::number(count)}});
        if (refresh)
            publishNode(node);
    }
}

} // namespace IC
