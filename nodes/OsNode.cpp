#include "nodes/OsNode.h"

#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"
#include "sysdata/osInfo_linux.h"

#include <ctime>

namespace IC
{

namespace
{

using NQ::OsInfo;

template <class Value> struct Fact {
    unsigned int id;
    bool (*get)(OsInfo& info, Value& out);
};
using TextFact = Fact<std::string>;
using NumberFact = Fact<unsigned int>;

template <auto getter, class Value> bool ask(OsInfo& info, Value& out)
{
    return (info.*getter)(out);
}

constexpr TextFact namingFacts[] = {
    {property::name, ask<&OsInfo::getOSName>},
    {property::version, ask<&OsInfo::getOSVersion>},
};

constexpr NumberFact storedFigures[] = {
    {property::processMaxNumber, ask<&OsInfo::getProcessMaxNumber>},
    {property::processMaxMemory, ask<&OsInfo::getProcessMaxMemory>},
    {property::userCount, ask<&OsInfo::getUserCount>},
    {property::licensedUserCount, ask<&OsInfo::getLicensedUserCount>},
    {property::virtualMemorySize, ask<&OsInfo::getVirtualMemorySize>},
    {property::virtualMemoryFree, ask<&OsInfo::getVirtualMemoryFree>},
};

constexpr TextFact localeFacts[] = {
    {property::languageEdition, ask<&OsInfo::getLanguageEdition>},
    {property::codeSet, ask<&OsInfo::getCodeSet>},
};

// In the order in which they are seeded.
constexpr NumberFact liveFigures[] = {
    {property::processCount, ask<&OsInfo::getProcessCount>},
    {property::physicalMemoryFree, ask<&OsInfo::getPhysicalMemoryFree>},
    {property::physicalMemorySize, ask<&OsInfo::getPhysicalMemorySize>},
    {property::swapFileSize, ask<&OsInfo::getSwapFileSize>},
    {property::swapFileFree, ask<&OsInfo::getSwapFileFree>},
    {property::swapFileSizeStored, ask<&OsInfo::getSwapFileSizeStored>},
};

template <std::size_t count>
void store(OsInfo& info, TextFact const (&facts)[count], MutableNode& node)
{
    for (TextFact const& fact : facts) {
        std::string text;
        if (fact.get(info, text))
            node.setProperty(fact.id, values::text(text));
    }
}

template <std::size_t count>
void store(OsInfo& info, NumberFact const (&facts)[count], MutableNode& node)
{
    for (NumberFact const& fact : facts) {
        unsigned int number = 0;
        if (fact.get(info, number))
            node.setProperty(fact.id, values::number(number));
    }
}

void logTime(NQ::log::Scope const& scope, char const* what, long seconds)
{
    time_t const time = seconds;
    char text[32] = "";
    ctime_r(&time, text);
    scope.progress(what, text);
}

} // namespace

OsNode::OsNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
               unsigned int nodeType, unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::log::entry(OSSWMI::unit, "OsNode::OsNode");
}

OsNode::~OsNode()
{
    NQ::log::lastEntry(OSSWMI::unit, "OsNode::~OsNode");
}

Error OsNode::getProperty(unsigned int id, PropertyValue& value) const
{
    NQ::log::Scope const scope(OSSWMI::unit, {"OsNode::getProperty"});
    OsInfo info;
    for (NumberFact const& figure : liveFigures) {
        if (figure.id != id)
            continue;
        unsigned int number = 0;
        if (figure.get(info, number))
            value = values::number(number);
        return values::success();
    }
    if (id == property::clearLog) {
        value = values::number(0);
        return values::success();
    }
    return MutableNode::getProperty(id, value);
}

void OsSwMI::createOsNodes()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    osNode_ = adopt(std::make_unique<OsNode>(nodeId, computerNode_->getNodeId(), miIds_,
                                             nodeType::operatingSystem, 0));
    setUp("Operating System");
    values::setProperties(
        *osNode_, {{property::fixedEnumeration, {EnumValue(static_cast<unsigned short>(35)), true}},
                   {property::requestedState, {EnumValue(1U), false}}, // the only false flag
                   {property::fixedNumbers, values::fixedNumberList()}});

    OsInfo info;
    store(info, namingFacts, *osNode_);
    values::setProperties(*osNode_, {{property::createUser, {"dummy", true}},
                                     {property::refresh, values::number(1)}});
    bool distributed = false;
    if (info.getDistributed(distributed))
        osNode_->setProperty(property::distributed, values::truth(distributed));
    store(info, storedFigures, *osNode_);
    store(info, localeFacts, *osNode_);

    // Contract: all share one value, so a figure that cannot be read stores the previous one.
    PropertyValue value = values::emptyValue();
    for (NumberFact const& figure : liveFigures) {
        osNode_->getProperty(figure.id, value);
        osNode_->setProperty(figure.id, value);
    }

    long time = 0;
    if (info.getLastBootTime(time)) {
        osNode_->setProperty(property::lastBootTime, values::date(time));
        logTime(scope, "LastBootTime = ", time);
    }
    if (info.getInstallDate(time)) {
        osNode_->setProperty(property::installDate, values::date(time));
        logTime(scope, "InstallDate = ", time);
    }
}

} // namespace IC
