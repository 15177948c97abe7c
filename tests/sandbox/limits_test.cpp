// A machine at its limits: no descriptors, processes or disk space left, and tools that print
// megabytes or die halfway. The plug-in must survive and leak nothing.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <pwd.h>
#include <set>
#include <string>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace limits_test
{

/** No other process on this machine has this id, so only the test's own count for its limit. */
constexpr uid_t lonelyUser = 54321;

std::set<std::string> openDescriptors()
{
    std::set<std::string> open;
    for (auto const& entry : std::filesystem::directory_iterator("/proc/self/fd"))
        open.insert(entry.path().filename());
    return open; // with one for the listing itself, each time
}

/** The lowest free descriptor; with this as the limit, none can be opened. */
rlim_t lowestFree()
{
    int const free = dup(STDIN_FILENO);
    close(free);
    return static_cast<rlim_t>(free);
}

bool hasChildren()
{
    return waitpid(-1, nullptr, WNOHANG) != -1 || errno != ECHILD;
}

/** Lowers a limit of this process while the object exists; the hard limit is unchanged. */
class Limit
{
public:
    Limit(int resource, rlim_t value) : resource_(static_cast<Resource>(resource))
    {
        getrlimit(resource_, &before_);
        rlimit const lowered{value, before_.rlim_max};
        setrlimit(resource_, &lowered);
    }
    ~Limit()
    {
        setrlimit(resource_, &before_);
    }
    Limit(Limit const&) = delete;
    Limit& operator=(Limit const&) = delete;

private:
    using Resource = __rlimit_resource;

    Resource const resource_;
    rlimit before_{};
};

/** Runs as an ordinary user while the object exists: limits on processes exclude root. */
class Ordinary
{
public:
    Ordinary()
    {
        if (setresuid(lonelyUser, lonelyUser, 0) != 0)
            std::abort();
    }
    ~Ordinary()
    {
        if (setresuid(0, 0, 0) != 0)
            std::abort();
    }
    Ordinary(Ordinary const&) = delete;
    Ordinary& operator=(Ordinary const&) = delete;
};

class Limits : public testing::Test
{
protected:
    Limits()
    {
        machine::lay("unitedlinux");
        machine::fake("/usr/sbin/lsmod", "echo Module Size Used by; echo loop 1 0\n");
        machine::fake("/usr/sbin/modinfo", "echo description: Loopback\n");
        std::filesystem::current_path("/tmp");
    }

    ~Limits() override
    {
        endpwent();
    }

    void write(unsigned int type, unsigned int id, IC::PropertyValue const& value)
    {
        std::vector<IC::MutableNode*> const nodes = plugin.nodes(type);
        if (!nodes.empty())
            nodes.back()->setProperty(id, value);
    }

    /** A start, live reads, a write of every kind that changes no account, and a stop. */
    void live()
    {
        plugin.initialize();
        EXPECT_EQ(plugin.nodes(IC::nodeType::operatingSystem).size(), 1U);
        for (IC::MutableNode const* node : plugin.nodes())
            for (auto const& entry : node->getProperties())
                property(*node, entry.first);
        IC::PropertyValue const zero(IC::Number(0U), true);
        IC::PropertyValue const nine(IC::Number(9U), true);
        write(IC::nodeType::operatingSystem, IC::property::refresh, zero);
        write(IC::nodeType::operatingSystem, IC::property::createUser,
              {"LocalGroupAdd,GroupName:CMPI_string:root", true});
        write(IC::nodeType::operatingSystem, IC::property::createUser,
              {"LocalGroupAddUser,GroupName:CMPI_string:none,UserName:CMPI_string:none", true});
        write(IC::nodeType::operatingSystem, IC::property::clearLog, nine);
        write(IC::nodeType::user, IC::property::inactiveTime, {"2030-01-01 00:00:00", true});
        plugin.unload();
        endpwent(); // Contract: counting users leaves libc's own cursor open
    }

    /** Like live, and expects that nothing is left open or running. */
    void liveAndLeaveNothing()
    {
        std::set<std::string> const before = openDescriptors();
        live();
        EXPECT_EQ(openDescriptors(), before);
        EXPECT_FALSE(hasChildren());
    }

    void expectAWholeStart()
    {
        plugin.initialize();
        EXPECT_EQ(plugin.nodes(IC::nodeType::driver).size(), 1U);
        EXPECT_FALSE(plugin.nodes(IC::nodeType::user).empty());
        plugin.unload();
    }

    Plugin plugin;
};

class DescriptorLimits : public Limits
{
protected:
    void SetUp() override
    {
#ifdef __SANITIZE_ADDRESS__
        GTEST_SKIP() << "without a descriptor the sanitizer cannot look at virtual tables";
#endif
    }
};

TEST_F(DescriptorLimits, LeaveNothingOpenWhereverTheyAreReached)
{
    rlim_t const used = lowestFree();
    for (rlim_t spare = 0; spare <= 6; ++spare) {
        SCOPED_TRACE(std::to_string(spare) + " descriptors to spare");
        std::set<std::string> const before = openDescriptors();
        {
            Limit const limit(RLIMIT_NOFILE, used + spare);
            live();
        }
        EXPECT_EQ(openDescriptors(), before);
        EXPECT_FALSE(hasChildren());
    }
    expectAWholeStart();
}

TEST_F(Limits, OfProcessesLeaveNoneWhereverTheyAreReached)
{
    for (rlim_t most = 0; most <= 4; ++most) {
        SCOPED_TRACE(std::to_string(most) + " processes at most");
        Ordinary const user;
        Limit const limit(RLIMIT_NPROC, most);
        liveAndLeaveNothing();
    }
    expectAWholeStart();
}

TEST_F(Limits, OfTheDiskDoNotChangeThePassword)
{
    ASSERT_EQ(mount("disk", "/mnt", "tmpfs", 0, "size=4k"), 0);
    std::filesystem::current_path("/mnt");
    std::ofstream("/mnt/all") << std::string(4096, 'x');
    std::string const user = "full";
    ASSERT_EQ(std::system("useradd -p first full"), 0);
    plugin.initialize();
    machine::recordShell();
    IC::Error const status = plugin.node(IC::nodeType::user, user)
                                 .setProperty(IC::property::password, {"$6$salt$newhash", true});
    EXPECT_EQ(status.getStatus(), 0U);
    EXPECT_EQ(machine::ran(),
              std::vector<std::string>{"chpasswd -e < usrandpwd ; rm -f usrandpwd"});
    EXPECT_EQ(machine::entry("/etc/shadow", user).at(1), "first");
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    plugin.unload();
    std::filesystem::current_path("/");
}

struct Output {
    char const* name;
    char const* script;
};

void PrintTo(Output const& output, std::ostream* out)
{
    *out << output.name;
}

constexpr Output outputs[] = {
    {"MegabytesInOneLine", "/usr/bin/head -c 3000000 /run/line\n"},
    {"MegabytesOfLines", "/usr/bin/yes 'key: value, 1 (x)' | /usr/bin/head -c 3000000\n"},
    {"HalfALineAndDie", "printf 'key: val'; kill -9 $$\n"},
    {"NothingAndDie", "kill -SEGV $$\n"},
};

/** Every tool of the machine fails in the same way. */
class Tools : public Limits, public testing::WithParamInterface<Output>
{
protected:
    Tools()
    {
        machine::write("/run/line", std::string(3000000, 'x'));
        for (char const* tool :
             {"/usr/sbin/modinfo", "/usr/bin/wc", "/usr/bin/sed", "/usr/bin/date", "/usr/bin/stat",
              "/usr/bin/cat", "/usr/bin/tr", "/usr/bin/cut", "/usr/bin/chage", "/usr/bin/id",
              "/usr/bin/passwd", "/usr/sbin/chpasswd", "/usr/sbin/useradd", "/usr/sbin/usermod",
              "/usr/sbin/userdel", "/usr/sbin/groupadd", "/usr/sbin/groupdel"})
            machine::fake(tool, GetParam().script);
    }
};

TEST_P(Tools, MakeMethodsAndReadsFailButDoNotEndThePlugin)
{
    Recording const recording;
    plugin.initialize();
    EXPECT_TRUE(plugin.nodes(IC::nodeType::logEntry).empty());
    EXPECT_FALSE(recording.texts(6000).empty());
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    // Also if a tool dies without output: the shell then prints a message.
    for (char const* call :
         {"LocalGroupDel,GroupName:CMPI_string:none", "UserAdd,UserName:CMPI_string:new"})
        EXPECT_EQ(os.setProperty(IC::property::createUser, {call, true}).getStatus(), 1U) << call;
    plugin.unload();
    endpwent();
    liveAndLeaveNothing();
}

TEST_F(Limits, DoNotApplyToALineOfMegabytesOfBlanks)
{
    machine::write("/run/line", std::string(3000000, ' '));
    machine::fake("/usr/sbin/lsmod", "/usr/bin/head -c 3000000 /run/line\n");
    liveAndLeaveNothing();
}

TEST_F(Limits, KeepTheModulesListedBeforeLsmodDied)
{
    machine::fake("/usr/sbin/lsmod",
                  "echo Module Size Used by; echo loop 1 0; printf 'xf'; kill -9 $$\n");
    plugin.initialize();
    EXPECT_EQ(plugin.nodes(IC::nodeType::driver).size(), 2U);
    EXPECT_NE(plugin.find(IC::nodeType::driver, "loop"), nullptr);
    EXPECT_NE(plugin.find(IC::nodeType::driver, "xf"), nullptr);
}

INSTANTIATE_TEST_SUITE_P(Without, Tools, testing::ValuesIn(outputs),
                         [](auto const& instance) { return std::string(instance.param.name); });

} // namespace limits_test
