// In each scenario, every system call that can fail is made to fail once, one after the other. Each
// time the plug-in must survive, nothing may stay open or locked, and the next start must be
// complete.

#include "TestPaths.h"
#include "frame/OsSwMI.h"
#include "host/OpenMI.h"
#include "host/Properties.h"
#include "tests/interpose/Allocation.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FileRoot.h"
#include "tests/support/ScratchFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <new>
#include <ostream>

namespace
{

using interpose::AnyCall;

/** A machine whose files and commands all answer, and whose locks are watched. */
class FakeMachine
{
public:
    FakeMachine()
    {
        libc::hooks().lckpwdf = [this] {
            accountsLocked = true;
            return 0;
        };
        libc::hooks().ulckpwdf = [this] {
            accountsLocked = false;
            return 0;
        };
        libc::hooks().popen = [this](char const* command, char const*) -> FILE* {
            ++openPipes;
            return streamOf(answer(command));
        };
        libc::hooks().pclose = [this](FILE* stream) {
            --openPipes;
            return std::fclose(stream);
        };
    }

    bool accountsLocked = false;
    int openPipes = 0;

private:
    static std::string answer(std::string const& command)
    {
        static std::map<std::string, std::string> const answers = {
            {"lsmod", "Module                  Size  Used by\nloop 1 0\nxfs 2 1\n"},
            {"modinfo loop", "description:    Loopback device\nversion: 1.0\n"},
            {"modinfo xfs", "license: GPL\n"},
            {"wc -l /var/log/messages", "2 /var/log/messages\n"},
            {"sed -n '1p' /var/log/messages", "Nov  1 10:00:00 host daemon: one\n"},
            {"sed -n '2p' /var/log/messages", "Nov  1 10:00:01 host daemon: two\n"},
            {"date", "Sat Nov 21 10:00:00 UTC 2026\n"},
            {"stat /etc/UnitedLinux-release | grep Change",
             "Change: 2010-05-12 10:23:45.000000000 +0200\n"},
            {"chage -l anna", "Last password change : Jan 01, 2008\nPassword expires : never\n"},
            {"/usr/bin/id \"anna\" 2>&1",
             "uid=1000(anna) gid=1000(anna) groups=1000(anna),1001(ben)\n"},
        };
        auto const found = answers.find(command);
        if (found != answers.end())
            return found->second;
        return command.find("useradd") != std::string::npos ? "rc=0\n" : "";
    }

    libc::HookGuard const guard_;
    FileRoot const root_{"machine"}; // in the test's own directory
};

IC::ManagementInterface& openInterface()
{
    IC::ManagementInterface* mi = nullptr;
    IC::Error* error = nullptr;
    OpenMI(&mi, &error);
    return *mi;
}

/** The first node of a type; for users, the one called anna. */
IC::Node* find(unsigned int type)
{
    std::vector<IC::Node*> nodes;
    openInterface().getMap(nodes);
    for (IC::Node* entry : nodes) {
        auto const* node = dynamic_cast<IC::MutableNode*>(entry);
        IC::PropertyValue name(IC::PropertyValue::EmptyKind, true);
        node->IC::MutableNode::getProperty(IC::property::name, name);
        if (node->getNodeType() == type &&
            (type != IC::nodeType::user || static_cast<std::string>(name) == "anna"))
            return entry;
    }
    return nullptr;
}

void start()
{
    openInterface().initialize(1, IC::Number(0U), IC::Number(0U));
}

bool variesByItself(unsigned int property)
{
    return property == IC::property::lastBootTime ||
           (property >= IC::property::processCount && property <= IC::property::swapFileFree);
}

/** The texts of the tree, to be compared with those of another start. */
std::vector<std::string> treeTexts()
{
    std::vector<IC::Node*> nodes;
    openInterface().getMap(nodes);
    std::vector<std::string> texts;
    for (IC::Node* node : nodes) {
        std::string text = node->getDescription();
        for (auto const& [id, value] : node->getProperties())
            if (!variesByItself(id))
                text += ' ' + std::to_string(id) + '=' + static_cast<std::string>(value);
        texts.push_back(text);
    }
    return texts;
}

void set(unsigned int type, unsigned int id, IC::PropertyValue const& value)
{
    IC::Node* const node = find(type);
    ASSERT_NE(node, nullptr) << "no node of type " << type;
    node->setProperty(id, value);
}

void readLive(unsigned int type, std::initializer_list<unsigned int> ids)
{
    IC::Node* const node = find(type);
    ASSERT_NE(node, nullptr) << "no node of type " << type;
    for (unsigned int const id : ids) {
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        node->getProperty(id, value);
    }
}

IC::PropertyValue number(unsigned int value)
{
    return {IC::Number(value), true};
}

IC::PropertyValue text(char const* value)
{
    return {value, true};
}

struct Scenario {
    char const* name;
    bool startsByItself;
    void (*run)();
};

void PrintTo(Scenario const& scenario, std::ostream* out)
{
    *out << scenario.name;
}

Scenario const scenarios[] = {
    {"Start", true, start},
    {"Refresh", false,
     [] { set(IC::nodeType::operatingSystem, IC::property::refresh, number(0)); }},
    {"ClearLog", false,
     [] { set(IC::nodeType::operatingSystem, IC::property::clearLog, number(9)); }},
    {"Restart", false,
     [] { set(IC::nodeType::operatingSystem, IC::property::requestedState, number(9)); }},
    {"UserAdd", false,
     [] {
         set(IC::nodeType::operatingSystem, IC::property::createUser,
             text("UserAdd,UserName:CMPI_string:carl,Comment:CMPI_string:Carl C,"
                  "daysMustKeepPassword:CMPI_uint32:3,Password:CMPI_string:secret"));
     }},
    {"GroupMember", false,
     [] {
         set(IC::nodeType::operatingSystem, IC::property::createUser,
             text("LocalGroupAddUser,LocalGroupName:CMPI_string:ben,"
                  "DomainAndMember:CMPI_string:anna"));
     }},
    {"Password", false,
     [] { set(IC::nodeType::user, IC::property::password, text("$6$new$hash")); }},
    {"Inactivity", false,
     [] { set(IC::nodeType::user, IC::property::inactiveTime, text("2030-01-01 00:00:00")); }},
    {"Expiration", false,
     [] {
         set(IC::nodeType::user, IC::property::passwordExpiration, text("2030-01-01 00:00:00"));
     }},
    {"Delete", false, [] { set(IC::nodeType::user, IC::property::deleteUser, number(1)); }},
    {"LiveReads", false,
     [] {
         readLive(IC::nodeType::operatingSystem,
                  {IC::property::processCount, IC::property::physicalMemoryFree,
                   IC::property::swapFileSizeStored});
         readLive(IC::nodeType::user, {IC::property::elementCount});
         readLive(IC::nodeType::group, {IC::property::elementCount});
         readLive(IC::nodeType::logEntry, {IC::property::message, IC::property::creationTime});
     }},
};

long openDescriptors()
{
    auto const listing = std::filesystem::directory_iterator("/proc/self/fd");
    return std::distance(begin(listing), end(listing));
}

class FailingCall : public testing::TestWithParam<std::tuple<Scenario, AnyCall*>>
{
protected:
    void SetUp() override
    {
        // "usrandpwd" is written to the working directory.
        std::filesystem::copy(MACHINES_DIR "/faults", folder_.path("machine"),
                              std::filesystem::copy_options::recursive);
        std::filesystem::current_path(folder_.name());
    }

    void TearDown() override
    {
        std::filesystem::current_path("/");
    }

    /**
     * Runs the scenario; call number at fails. The start before it shows that the previous run left
     * nothing.
     *
     * @return how many of the calls were made
     */
    unsigned long runWithFault(Scenario const& scenario, AnyCall& call, unsigned long at) const
    {
        FakeMachine machine;
        long const descriptors = openDescriptors();
        if (!scenario.startsByItself) {
            start();
            EXPECT_EQ(treeTexts(), whole_);
        }
        call.failAt(at);
        try {
            scenario.run();
        } catch (std::bad_alloc const&) {
            EXPECT_EQ(&call, &interpose::allocation());
        }
        unsigned long const made = call.stopCounting();

        EXPECT_FALSE(machine.accountsLocked);
        EXPECT_EQ(machine.openPipes, 0);
        EXPECT_EQ(openDescriptors(), descriptors);
        EXPECT_EQ(IC::OSSWMI::myuserlock.lock(0), 0) << "left locked";
        IC::OSSWMI::myuserlock.unlock();
        EXPECT_FALSE(IC::OSSWMI::MI_call);
        openInterface().unload();
        return made;
    }

    static std::vector<std::string> treeOfAWholeStart()
    {
        FakeMachine const machine;
        start();
        std::vector<std::string> texts = treeTexts();
        openInterface().unload();
        return texts;
    }

    ScratchFolder const folder_;
    std::vector<std::string> whole_;
};

TEST_P(FailingCall, LeavesNothingOpenOrLocked)
{
    auto const& [scenario, call] = GetParam();
    whole_ = treeOfAWholeStart();
    unsigned long const calls = runWithFault(scenario, *call, 0);
    if (scenario.startsByItself) {
        EXPECT_GT(calls, 0U) << "a start makes every call";
    }
    for (unsigned long at = 1; at <= calls && !HasFailure(); ++at) {
        SCOPED_TRACE(call->name() + std::string(" number ") + std::to_string(at) + " of " +
                     std::to_string(calls));
        runWithFault(scenario, *call, at);
        if (scenario.startsByItself || at == calls) {
            EXPECT_EQ(treeOfAWholeStart(), whole_);
        }
    }
}

std::vector<AnyCall*> allCalls()
{
    libc::Hooks& hooks = libc::hooks();
    return {&hooks.popen,       &hooks.fopen,
            &hooks.fgets,       &hooks.sysinfo,
            &hooks.uname,       &hooks.lckpwdf,
            &hooks.fgetpwent_r, &hooks.fgetspent_r,
            &hooks.getgrent,    &interpose::allocation()};
}

std::string caseName(testing::TestParamInfo<std::tuple<Scenario, AnyCall*>> const& instance)
{
    auto const& [scenario, call] = instance.param;
    return scenario.name + std::string("_") + call->name();
}

INSTANTIATE_TEST_SUITE_P(Faults, FailingCall,
                         testing::Combine(testing::ValuesIn(scenarios),
                                          testing::ValuesIn(allCalls())),
                         caseName);

} // namespace
