#ifndef NODES_LOGENTRYNODE_H
#define NODES_LOGENTRYNODE_H

#include "host/MutableNode.h"

namespace IC
{

/** One of the newest lines of the system log. */
class LogEntryNode : public MutableNode
{
public:
    LogEntryNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                 unsigned int nodeType, unsigned int index);
    ~LogEntryNode() override;

    Error getProperty(unsigned int id, PropertyValue& value) const override;
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;
};

} // namespace IC

#endif
