// The system log as read by the real wc, sed and date.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <grp.h>
#include <sys/stat.h>
#include <unistd.h>

namespace log_test
{

using systemLog::path;

class Log : public testing::Test
{
protected:
    Log()
    {
        useZone("UTC0");
        std::filesystem::copy_file("/usr/bin/date", "/usr/bin/date.real");
        machine::fake("/usr/bin/date", "echo 'Sat Nov 21 03:15:30 UTC 2026'\n");
    }

    static std::string lines(unsigned int count)
    {
        std::string text;
        for (std::string const& line : systemLog::messages(count))
            text += line + "\n";
        return text;
    }

    std::vector<IC::MutableNode*> entries() const
    {
        return plugin.nodes(IC::nodeType::logEntry);
    }

    /** A property of all entries, in their order, as it is read now. */
    Lines read(unsigned int property) const
    {
        Lines found;
        for (IC::MutableNode const* entry : entries())
            found.push_back(text(*entry, property));
        return found;
    }

    /** The messages stored in the entries. */
    Lines messages() const
    {
        Lines found;
        for (IC::MutableNode const* entry : entries())
            found.push_back(stored(*entry, IC::property::message));
        return found;
    }

    /** Starts the plug-in on a log with this text. */
    void startOn(std::string const& log, mode_t mode = 0644)
    {
        machine::write(path, log, mode);
        plugin.initialize();
    }

    void clear() const
    {
        plugin.node(IC::nodeType::operatingSystem)
            .setProperty(IC::property::clearLog, {IC::Number(9U), true});
    }

    static void dropPrivileges()
    {
        ASSERT_EQ(setgroups(0, nullptr), 0);
        ASSERT_EQ(setresgid(65534, 65534, 65534), 0);
        ASSERT_EQ(setresuid(65534, 65534, 65534), 0);
    }

    Plugin plugin;
};

/** "*message NEWEST*" down to the number of entries given. */
Lines newest(int line, int entries)
{
    Lines found;
    for (int i = 0; i < entries; ++i)
        found.push_back("*message " + std::to_string(line - i) + "*");
    return found;
}

class LogOfLines : public Log, public testing::WithParamInterface<int>
{
};

TEST_P(LogOfLines, ShowsTheNewestFiftyAtMost)
{
    startOn(lines(static_cast<unsigned int>(GetParam())));
    EXPECT_EQ(messages(), newest(GetParam(), std::min(GetParam(), 50)));
    EXPECT_EQ(read(IC::property::message), messages());
    for (std::size_t i = 0; i < entries().size(); ++i)
        EXPECT_EQ(entries()[i]->getIndex(), i + 1);
    EXPECT_EQ(plugin.nodes(IC::nodeType::log).size(), 1U);
}

INSTANTIATE_TEST_SUITE_P(All, LogOfLines, testing::Values(0, 51));

TEST_F(Log, UnderstandsTheRealDate)
{
    std::filesystem::rename("/usr/bin/date.real", "/usr/bin/date");
    startOn(lines(1));
    EXPECT_EQ(stored(*entries().at(0), IC::property::creationTime).substr(4), "-11-20 10:11:01");
}

TEST_F(Log, ShowsLinesOfEveryOddForm)
{
    startOn("\nshort\nNov 20 10:11:12\nNov 20 10:11:13 \nNov 20 10:11:14 " +
            std::string(3000, 'm') + "\n2026-11-20T10:11:12.123456+00:00 host sshd[1]: open\n" +
            std::string(2000, '\0') + "\nNov 20 10:11:15 a" + std::string("\0b\n", 3) +
            "Nov 20 10:11:59 no line end");
    EXPECT_EQ(messages(), (Lines{"*a*", "**", "*:12.123456+00:00 host sshd[1]: open*",
                                 "*" + std::string(495, 'm') + "*", "**", "**", "**", "**"}));
    EXPECT_EQ(read(IC::property::creationTime),
              (Lines{"2026-11-20 10:11:15", "(status 1)", "(status 1)", "2026-11-20 10:11:14",
                     "2026-11-20 10:11:13", "2026-11-20 10:11:12", "(status 1)", "(status 1)"}));
}

TEST_F(Log, IsReadAgainAsItGrowsShrinksAndVanishes)
{
    startOn(lines(3));
    std::ofstream(path, std::ios::app) << "Nov 20 10:11:30 news\n";
    EXPECT_EQ(read(IC::property::message), (Lines{"*news*", "*message 3*", "*message 2*"}));
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "2026-11-20 10:11:30");
    machine::write(path, lines(1));
    EXPECT_EQ(read(IC::property::message), (Lines{"*message 1*", "**", "(status 1)"}));
    EXPECT_EQ(text(*entries()[2], IC::property::creationTime), "(status 1)");
    machine::remove(path);
    EXPECT_EQ(read(IC::property::message), (Lines{"**", "(status 1)", "(status 1)"}));
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "(status 1)");
    EXPECT_EQ(messages(), newest(3, 3));
}

TEST_F(Log, HasNoEntriesWithoutReadPermission)
{
    machine::write(path, lines(3), 0600);
    dropPrivileges();
    Recording const recording;
    plugin.initialize();
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(recording.has("Invalid format: buffer = ", 6000));
}

TEST_F(Log, KeepsItsOwnerAndModeWhenItIsCleared)
{
    machine::write(path, lines(3), 0640);
    ASSERT_EQ(chown(path, 12345, 23456), 0);
    plugin.initialize();
    IC::MutableNode const* const log = &plugin.node(IC::nodeType::log);
    clear();
    EXPECT_TRUE(entries().empty());
    EXPECT_EQ(&plugin.node(IC::nodeType::log), log);
    struct stat now {
    };
    ASSERT_EQ(stat(path, &now), 0);
    EXPECT_EQ(now.st_size, 0);
    EXPECT_EQ(now.st_mode & 07777U, 0640U);
    EXPECT_EQ(now.st_uid, 12345U);
    EXPECT_EQ(now.st_gid, 23456U);
}

} // namespace log_test
