#ifndef TESTS_CONTRACT_RECORDING_HOST_LOADED_H
#define TESTS_CONTRACT_RECORDING_HOST_LOADED_H

#include "TestPaths.h"
#include "tests/contract/recording_host/RecordingHost.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FileRoot.h"
#include "tests/support/Insides.h"
#include "tests/support/Lines.h"
#include "tests/support/Plugin.h"

#include <gtest/gtest.h>
#include <new>
#include <string>
#include <vector>

using Ids = std::vector<unsigned int>;

/** The plug-in in the recording host, on the machine "redhat", where no command can be started. */
class Loaded : public testing::Test
{
protected:
    IC::OsSwMI& mi() const
    {
        return static_cast<IC::OsSwMI&>(plugin.interface());
    }

    /** One of the interface's protected members, such as &OpenInterface::nodes_. */
    template <class Member, class Class> Member& inside(Member Class::*member) const
    {
        return mi().*member;
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
        auto* const constructor = reinterpret_cast<Constructor*>(
            plugin.symbol("IC::" + className + "::" + className +
                          "(unsigned int, unsigned int, std::vector<unsigned int, "
                          "std::allocator<unsigned int> >, "
                          "unsigned int, unsigned int)"));
        void* const place = ::operator new(sizeof(IC::MutableNode));
        constructor(place, 11, 12, {13, 14}, 15, 16);
        return static_cast<IC::MutableNode*>(place);
    }

    RecordingHost& host = freshHost();
    FileRoot files{MACHINES_DIR "/redhat"};
    FakeCommands commands;
    Plugin plugin;
};

#endif
