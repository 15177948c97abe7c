#include "nodes/LogEntryNode.h"

#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"
#include "sysdata/logInfo_linux.h"

#include <algorithm>

namespace IC
{

namespace
{

/** Each entry runs several commands when it is built. */
constexpr unsigned int maxEntries = 50;

} // namespace

LogEntryNode::LogEntryNode(unsigned int nodeId, unsigned int parentId,
                           std::vector<unsigned int> miIds, unsigned int nodeType,
                           unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::log::entry(OSSWMI::unit, "LogEntryNode::LogEntryNode");
}

LogEntryNode::~LogEntryNode()
{
    NQ::log::lastEntry(OSSWMI::unit, "LogEntryNode::~LogEntryNode");
}

Error LogEntryNode::getProperty(unsigned int id, PropertyValue& value) const
{
    NQ::log::Scope const scope(OSSWMI::unit, {"LogEntryNode::getProperty"});
    unsigned int const index = getIndex();
    NQ::logInfo log;
    std::string text;
    long time = 0;
    switch (id) {
    case property::message:
        if (!log.getData(text, index))
            return values::failure();
        value = values::text(text);
        return values::success();
    case property::id:
        value = values::number(index);
        return values::success();
    case property::creationTime:
        if (!log.getCreationTime(time, index))
            return values::failure();
        value = values::date(time);
        return values::success();
    default:
        return MutableNode::getProperty(id, value);
    }
}

Error LogEntryNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::log::Scope const scope(OSSWMI::unit, {"LogEntryNode::setProperty"});
    return MutableNode::setProperty(id, value);
}

void OsSwMI::createLogEntryNodes(bool refresh)
{
    NQ::log::Scope const scope(OSSWMI::unit);
    if (refresh) {
        for (Node* node : logEntryNodes_)
            deleteNode(node);
        logEntryNodes_.clear();
    }
    unsigned int const count = std::min(NQ::logInfo().getMaxLine(), maxEntries);
    logEntryNodes_.reserve(logEntryNodes_.size() + count);
    for (unsigned int index = 1; index <= count; ++index) {
        unsigned int const nodeId = takeNodeId();
        MutableNode* const node =
            adopt(std::make_unique<LogEntryNode>(nodeId, logNode_->getNodeId(), miIds_,
                                                 nodeType::logEntry, index),
                  &logEntryNodes_);
        setUp("OS LogEntry");
        node->setProperty(property::id, values::number(index));
        PropertyValue value = values::emptyValue();
        for (unsigned int const id : {property::message, property::creationTime})
            if (node->getProperty(id, value).getStatus() == 0)
                node->setProperty(id, value);
        if (refresh)
            publishNode(node);
    }
}

} // namespace IC
