// The system log as read by the real wc, sed and date.

#include "host/Properties.h"
#include "mihost/runtime/Runtime.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <grp.h>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace log_test
{

using systemLog::path;
constexpr auto& wc = systemLog::count;
constexpr auto sed = systemLog::line;

class Log : public testing::Test
{
protected:
    Log()
    {
        useZone("UTC0");
        std::filesystem::copy_file("/usr/bin/date", "/usr/bin/date.real");
        say("Sat Nov 21 03:15:30 UTC 2026");
    }

    /** Lets date print this; wc and sed are the real ones in every test. */
    static void say(std::string const& date)
    {
        machine::fake("/usr/bin/date", "echo '" + date + "'\n");
    }

    static std::string lines(unsigned int count)
    {
        std::string text;
        for (std::string const& line : systemLog::messages(count))
            text += line + "\n";
        return text;
    }

    static void append(std::string const& text)
    {
        std::ofstream(path, std::ios::app) << text;
    }

    std::vector<IC::MutableNode*> entries() const
    {
        return plugin.nodes(IC::nodeType::logEntry);
    }

    /** The messages stored in the entry nodes, in their order. */
    Lines messages() const
    {
        Lines found;
        for (IC::MutableNode const* entry : entries())
            found.push_back(stored(*entry, IC::property::message));
        return found;
    }

    /** Starts the plug-in on a log with this text. */
    void startOn(std::string const& log)
    {
        machine::write(path, log);
        plugin.initialize();
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

TEST_F(Log, OfNoLinesHasNoEntries)
{
    startOn("");
    EXPECT_TRUE(entries().empty());
    EXPECT_EQ(plugin.nodes(IC::nodeType::log).size(), 1U);
}

class LogOfLines : public Log, public testing::WithParamInterface<int>
{
};

TEST_P(LogOfLines, ShowsTheNewestFiftyAtMost)
{
    startOn(lines(GetParam()));
    EXPECT_EQ(messages(), newest(GetParam(), std::min(GetParam(), 50)));
    for (std::size_t i = 0; i < entries().size(); ++i) {
        EXPECT_EQ(entries()[i]->getIndex(), i + 1);
        EXPECT_EQ(text(*entries()[i], IC::property::message), messages()[i]);
    }
}

INSTANTIATE_TEST_SUITE_P(All, LogOfLines, testing::Values(1, 3, 50, 51, 120));

TEST_F(Log, IsReadByTheCommandsOfEachReadInOrder)
{
    startOn(lines(3));
    machine::recordShell();
    text(*entries()[1], IC::property::message);
    EXPECT_EQ(machine::ran(), (Lines{wc, wc, wc, sed(2)}));
    machine::forget();
    text(*entries()[1], IC::property::creationTime);
    EXPECT_EQ(machine::ran(), (Lines{wc, wc, wc, sed(2), "date"}));
    machine::forget();
    text(*entries()[1], IC::property::id);
    EXPECT_EQ(machine::ran(), Lines{});
}

TEST_F(Log, RunsNineCommandsForEachEntryAtTheStart)
{
    machine::write(path, lines(2));
    machine::recordShell();
    plugin.initialize();
    Lines expected{wc};
    for (int const line : {2, 1})
        for (std::string const& command :
             Lines{wc, wc, wc, sed(line), wc, wc, wc, sed(line), "date"})
            expected.push_back(command);
    Lines const all = machine::ran();
    ASSERT_GE(all.size(), expected.size());
    EXPECT_EQ(Lines(all.end() - static_cast<std::ptrdiff_t>(expected.size()), all.end()), expected);
}

TEST_F(Log, ShowsTheTimeOfEachEntry)
{
    startOn("Nov  2 01:02:03 host one\nJan 31 23:59:59 host two\nFeb 29 12:00:00 host three\n");
    ASSERT_EQ(entries().size(), 3U);
    // February has 28 days in 2026, so this is the day after.
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "2026-03-01 12:00:00");
    EXPECT_EQ(text(*entries()[1], IC::property::creationTime), "2026-01-31 23:59:59");
    EXPECT_EQ(text(*entries()[2], IC::property::creationTime), "2026-11-02 01:02:03");
}

TEST_F(Log, DatesDecemberReadInJanuaryBackAndNothingElse)
{
    say("Fri Jan  2 03:15:30 UTC 2026");
    startOn("Nov 30 10:11:12 a\nDec 31 23:59:59 b\nJan  1 00:00:01 c\n");
    ASSERT_EQ(entries().size(), 3U);
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "2026-01-01 00:00:01");
    EXPECT_EQ(text(*entries()[1], IC::property::creationTime), "2025-12-31 23:59:59");
    EXPECT_EQ(text(*entries()[2], IC::property::creationTime), "2026-11-30 10:11:12");
    say("Thu Dec 31 03:15:30 UTC 2026");
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "2026-01-01 00:00:01");
    EXPECT_EQ(text(*entries()[1], IC::property::creationTime), "2026-12-31 23:59:59");
}

TEST_F(Log, UnderstandsTheRealDate)
{
    std::filesystem::rename("/usr/bin/date.real", "/usr/bin/date");
    startOn(lines(1));
    EXPECT_EQ(stored(*entries().at(0), IC::property::creationTime).substr(4), "-11-20 10:11:01");
}

TEST_F(Log, ShowsShortLinesAsEmptyMessages)
{
    startOn("\nshort\nNov 20 10:11:12\nNov 20 10:11:13 \nNov 20 10:11:14 x\n");
    EXPECT_EQ(messages(), (Lines{"*x*", "**", "**", "**", "**"}));
    ASSERT_EQ(entries().size(), 5U);
    EXPECT_EQ(stored(*entries()[1], IC::property::creationTime), "2026-11-20 10:11:13");
    EXPECT_EQ(stored(*entries()[2], IC::property::creationTime), "2026-11-20 10:11:12");
    EXPECT_EQ(stored(*entries()[3], IC::property::creationTime), "(unset)");
    EXPECT_EQ(stored(*entries()[4], IC::property::creationTime), "(unset)");
    EXPECT_EQ(text(*entries()[4], IC::property::creationTime), "(status 1)");
}

TEST_F(Log, ShowsLinesWithAnotherStampWithoutATime)
{
    startOn("2026-11-20T10:11:12.123456+00:00 host sshd[1]: session opened\n");
    ASSERT_EQ(entries().size(), 1U);
    EXPECT_EQ(messages(), Lines{"*:12.123456+00:00 host sshd[1]: session opened*"});
    EXPECT_EQ(stored(*entries()[0], IC::property::creationTime), "(unset)");
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "(status 1)");
}

TEST_F(Log, OmitsALastLineWithoutALineEnd)
{
    startOn(lines(2) + "Nov 20 10:11:59 half a line");
    EXPECT_EQ(messages(), newest(2, 2));
}

TEST_F(Log, ShowsTheFirst495CharactersOfALongMessage)
{
    startOn("Nov 20 10:11:12 " + std::string(3000, 'm') + "\nNov 20 10:11:13 next\n");
    EXPECT_EQ(messages(), (Lines{"*next*", "*" + std::string(495, 'm') + "*"}));
}

TEST_F(Log, SurvivesBinaryGarbage)
{
    std::string garbage;
    for (unsigned int i = 0; i < 20000; ++i)
        garbage.push_back(static_cast<char>((i * 7919U) >> 3));
    startOn(garbage + "\n" + std::string(2000, '\0') + "\nNov 20 10:11:12 a" +
            std::string("\0b\n", 3));
    ASSERT_GE(entries().size(), 2U);
    EXPECT_EQ(messages()[0], "*a*");
    EXPECT_EQ(messages()[1], "**");
}

TEST_F(Log, ShiftsItsEntriesAsItGrows)
{
    startOn(lines(3));
    append("Nov 20 10:11:30 news\n");
    ASSERT_EQ(entries().size(), 3U);
    EXPECT_EQ(text(*entries()[0], IC::property::message), "*news*");
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "2026-11-20 10:11:30");
    EXPECT_EQ(text(*entries()[2], IC::property::message), "*message 2*");
    EXPECT_EQ(messages(), newest(3, 3));
}

TEST_F(Log, FailsTheReadsOfEntriesThatItHasLost)
{
    startOn(lines(3));
    machine::write(path, lines(1));
    ASSERT_EQ(entries().size(), 3U);
    Recording const recording;
    EXPECT_EQ(text(*entries()[0], IC::property::message), "*message 1*");
    EXPECT_EQ(text(*entries()[1], IC::property::message), "**");
    EXPECT_EQ(text(*entries()[2], IC::property::message), "(status 1)");
    EXPECT_EQ(text(*entries()[2], IC::property::creationTime), "(status 1)");
    EXPECT_EQ(recording.texts(6000), (Lines{"Invalid index: getMaxLine()=1, Index=3",
                                            "Invalid index: getMaxLine()=1, logIndex=3"}));
}

TEST_F(Log, HasNoEntriesIfItIsMissing)
{
    machine::remove(path);
    Recording const recording;
    plugin.initialize();
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(recording.has("Invalid format: buffer = ", 6000));
}

TEST_F(Log, FailsTheReadsOfEntriesOnceItIsMissing)
{
    startOn(lines(2));
    machine::remove(path);
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(text(*entries()[0], IC::property::message), "**");
    EXPECT_EQ(text(*entries()[0], IC::property::creationTime), "(status 1)");
    EXPECT_EQ(text(*entries()[1], IC::property::message), "(status 1)");
}

TEST_F(Log, HasNoEntriesWithoutReadPermission)
{
    machine::write(path, lines(3), 0600);
    ASSERT_EQ(setgroups(0, nullptr), 0);
    ASSERT_EQ(setresgid(65534, 65534, 65534), 0);
    ASSERT_EQ(setresuid(65534, 65534, 65534), 0);
    Recording const recording;
    plugin.initialize();
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(recording.has("Invalid format: buffer = ", 6000));
}

TEST_F(Log, HasNoEntriesIfWcCannotBeStarted)
{
    libc::refuse(wc);
    Recording const recording;
    startOn(lines(3));
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(recording.has("Cannot open process: wc -l /var/log/messages", 6000));
}

TEST_F(Log, HasAnEmptyEntryIfSedCannotBeStarted)
{
    libc::refuse(sed(2));
    Recording const recording;
    startOn(lines(3));
    EXPECT_EQ(messages(), (Lines{"*message 3*", "**", "*message 1*"}));
    EXPECT_EQ(stored(*entries().at(1), IC::property::creationTime), "(unset)");
    EXPECT_TRUE(recording.has("sed -n '%dp' /var/log/messages", 6000));
}

TEST_F(Log, IsOfTheYear1970IfDateCannotBeStarted)
{
    libc::refuse("date");
    Recording const recording;
    startOn(lines(1));
    EXPECT_EQ(stored(*entries().at(0), IC::property::creationTime), "1970-01-01 00:00:00");
    EXPECT_TRUE(recording.has("Cannot opne process: date", 6000));
}

TEST_F(Log, HasNoTimesIfDatePrintsAnotherForm)
{
    say("2026-11-21");
    Recording const recording;
    startOn(lines(1));
    EXPECT_EQ(stored(*entries().at(0), IC::property::creationTime), "(unset)");
    EXPECT_EQ(messages(), newest(1, 1));
    EXPECT_TRUE(recording.has("Invalid format: buffer = 2026-11-21\n", 6000));
}

/** Counts the nodes of which the host is informed. */
struct NodeCounter : mihost::NodeObserver {
    NodeCounter()
    {
        mihost::setNodeObserver(this);
    }

    ~NodeCounter() override
    {
        mihost::setNodeObserver(nullptr);
    }

    void nodeAdded(IC::Node const&) override
    {
        ++added;
    }

    void nodeDeleted(IC::Node const&) override
    {
        ++deleted;
    }

    int added = 0;
    int deleted = 0;
};

TEST_F(Log, LosesItsEntriesThroughTheHostWhenItIsCleared)
{
    machine::write(path, lines(3), 0640);
    plugin.initialize();
    IC::MutableNode const* const log = &plugin.node(IC::nodeType::log);
    NodeCounter const counted;
    plugin.node(IC::nodeType::operatingSystem)
        .setProperty(IC::property::clearLog, {IC::Number(9U), true});
    EXPECT_EQ(counted.deleted, 3);
    EXPECT_EQ(counted.added, 0);
    EXPECT_TRUE(entries().empty());
    EXPECT_EQ(&plugin.node(IC::nodeType::log), log);
    EXPECT_EQ(machine::read(path), "");
    EXPECT_EQ(std::filesystem::status(path).permissions(), std::filesystem::perms(0640));
}

TEST_F(Log, GetsEntriesForLinesWrittenDuringTheClearing)
{
    startOn(lines(2));
    // A logger that writes between the clearing and the count.
    machine::write("/usr/local/bin/wc",
                   "#!/bin/sh\n[ -s /var/log/messages ] || "
                   "echo 'Nov 20 10:11:40 news' >/var/log/messages\n"
                   "exec /usr/bin/wc \"$@\"\n",
                   0755);
    NodeCounter const counted;
    plugin.node(IC::nodeType::operatingSystem)
        .setProperty(IC::property::clearLog, {IC::Number(9U), true});
    EXPECT_EQ(counted.deleted, 2);
    EXPECT_EQ(counted.added, 1);
    EXPECT_EQ(messages(), Lines{"*news*"});
}

TEST_F(Log, KeepsLinesAndEntriesIfItCannotBeCleared)
{
    startOn(lines(2));
    ASSERT_EQ(setgroups(0, nullptr), 0);
    ASSERT_EQ(setresgid(65534, 65534, 65534), 0);
    ASSERT_EQ(setresuid(65534, 65534, 65534), 0);
    NodeCounter const counted;
    plugin.node(IC::nodeType::operatingSystem)
        .setProperty(IC::property::clearLog, {IC::Number(9U), true});
    EXPECT_EQ(machine::read(path), lines(2));
    EXPECT_EQ(messages(), newest(2, 2));
    EXPECT_EQ(counted.deleted + counted.added, 0);
}

TEST_F(Log, IsUnchangedWhenAnEntryIsWritten)
{
    startOn(lines(1));
    entries().at(0)->setProperty(IC::property::message, IC::PropertyValue("mine", true));
    EXPECT_EQ(machine::read(path), lines(1));
    EXPECT_EQ(stored(*entries().at(0), IC::property::message), "mine");
    EXPECT_EQ(text(*entries().at(0), IC::property::message), "*message 1*");
}

TEST_F(Log, KeepsItsOwnerWhenItIsCleared)
{
    machine::write(path, lines(1), 0640);
    ASSERT_EQ(chown(path, 12345, 23456), 0);
    plugin.initialize();
    plugin.node(IC::nodeType::operatingSystem)
        .setProperty(IC::property::clearLog, {IC::Number(9U), true});
    struct stat now {
    };
    ASSERT_EQ(stat(path, &now), 0);
    EXPECT_EQ(now.st_size, 0);
    EXPECT_EQ(now.st_uid, 12345U);
    EXPECT_EQ(now.st_gid, 23456U);
}

} // namespace log_test
