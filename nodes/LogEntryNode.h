#ifndef NODES_LOGENTRYNODE_H
#define NODES_LOGENTRYNODE_H

#include "host/MutableNode.h"

namespace IC
{

/**
 * One of the newest lines of the system log; index 1 is the last line.
 *
 * Message and time are read from the log each time, so once the log has grown they are those of a
 * newer line. The stored copies are from the time the node was built.
 */
class LogEntryNode : public MutableNode
{
public:
    LogEntryNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                 unsigned int nodeType, unsigned int index);
    ~LogEntryNode() override;

    /** Status 1, and value unchanged, for a message or time that cannot be read. */
    Error getProperty(unsigned int id, PropertyValue& value) const override;

    /** Stores the value in the node only; the log is unchanged. */
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;
};

} // namespace IC

#endif
