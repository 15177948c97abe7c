#ifndef TESTS_SUPPORT_INSIDES_H
#define TESTS_SUPPORT_INSIDES_H

#include "frame/OsSwMI.h"
#include "sysdata/logInfo_linux.h"

/**
 * The protected members of the interface object, open to tests.
 *
 * Contract: host and plug-in both work on them, each compiled by itself, so their order, types and
 * meaning are fixed. No test opens the members of a class that is not in this file.
 */
class OpenFramework : public IC::ManagementInterface
{
public:
    using ManagementInterface::loadCallBack_;
    using ManagementInterface::loadCallBackContext_;
    using ManagementInterface::lookupCallBack_;
    using ManagementInterface::miId_;
    using ManagementInterface::miIds_;
    using ManagementInterface::nextNodeId_;
    using ManagementInterface::nodes_;
};

/** The same members, open in the plug-in's own class. */
class OpenInterface : public IC::OsSwMI
{
public:
    using OsSwMI::computerNode_;
    using OsSwMI::currentNode_;
    using OsSwMI::groupNodes_;
    using OsSwMI::loadCallBack_;
    using OsSwMI::loadCallBackContext_;
    using OsSwMI::logEntryNodes_;
    using OsSwMI::logNode_;
    using OsSwMI::lookupCallBack_;
    using OsSwMI::miId_;
    using OsSwMI::miIds_;
    using OsSwMI::nextNodeId_;
    using OsSwMI::nodeIds_;
    using OsSwMI::nodes_;
    using OsSwMI::osNode_;
    using OsSwMI::osSwNode_;
    using OsSwMI::rootNode_;
    using OsSwMI::userNodes_;
};

/**
 * The only member of a log reader.
 *
 * Contract: hosts know the size of the object. Its text is empty, and nothing reads or writes it.
 */
inline std::string& onlyMember(NQ::logInfo& log)
{
    static_assert(sizeof log == sizeof(std::string));
    return reinterpret_cast<std::string&>(log);
}

#endif
