#ifndef TESTS_CONTRACT_RECORDING_HOST_LOADED_H
#define TESTS_CONTRACT_RECORDING_HOST_LOADED_H

#include "TestPaths.h"
#include "frame/OsSwMI.h"
#include "tests/contract/recording_host/RecordingHost.h"
#include "tests/support/Libc.h"
#include "tests/support/Plugin.h"

#include <gtest/gtest.h>
#include <new>
#include <string>
#include <vector>

using Lines = std::vector<std::string>;
using Ids = std::vector<unsigned int>;

/** The interface object with its protected members open. */
class Insides : public IC::OsSwMI
{
public:
    static auto& nextNodeId(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::nextNodeId_);
    }
    static auto& miIds(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::miIds_);
    }
    static auto& nodes(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::nodes_);
    }
    static auto& loadCallBack(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::loadCallBack_);
    }
    static auto& loadCallBackContext(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::loadCallBackContext_);
    }
    static auto& lookupCallBack(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::lookupCallBack_);
    }
    static auto& nodeIds(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::nodeIds_);
    }
    static auto& currentNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::currentNode_);
    }
    static auto& osSwNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::osSwNode_);
    }
    static auto& rootNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::rootNode_);
    }
    static auto& computerNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::computerNode_);
    }
    static auto& logNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::logNode_);
    }
    static auto& osNode(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::osNode_);
    }
    static auto& userNodes(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::userNodes_);
    }
    static auto& groupNodes(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::groupNodes_);
    }
    static auto& logEntryNodes(IC::OsSwMI& mi)
    {
        return mi.*(&Insides::logEntryNodes_);
    }
};

/** The plug-in in the recording host, on the machine "redhat", where no command can be started. */
class Loaded : public testing::Test
{
protected:
    IC::OsSwMI& mi() const
    {
        return static_cast<IC::OsSwMI&>(plugin.interface());
    }

    /** One of the library's own objects. */
    template <class Object> Object& object(char const* symbol) const
    {
        return *static_cast<Object*>(plugin.symbol(symbol));
    }

    /** Makes a node with one of the plug-in's own constructors. */
    IC::MutableNode* construct(std::string const& className) const
    {
        using Constructor = void(void* self, unsigned int nodeId, unsigned int parentId, Ids miIds,
                                 unsigned int nodeType, unsigned int index);
        std::string const symbol =
            "_ZN2IC" + std::to_string(className.size()) + className + "C1EjjSt6vectorIjSaIjEEjj";
        auto* const constructor = reinterpret_cast<Constructor*>(plugin.symbol(symbol.c_str()));
        void* const place = ::operator new(sizeof(IC::MutableNode));
        constructor(place, 11, 12, {13, 14}, 15, 16);
        return static_cast<IC::MutableNode*>(place);
    }

    RecordingHost& host = freshHost();
    libc::FileRoot files{MACHINES_DIR "/redhat"};
    libc::FakeCommands commands;
    Plugin plugin;
};

#endif
