// The reference runtime's log sinks.

#include "mihost/runtime/Sinks.h"

#include "host/VXLogger.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdio>

namespace sinks_test
{

using mihost::LineWriter;
using VXLog::VXLogger;

class LogSinks : public testing::Test
{
protected:
    ~LogSinks() override
    {
        mihost::setLogSink(nullptr);
        std::fclose(stream_);
    }

    /** Logs the text with both of the logger's operations, as a plug-in does. */
    static void say(std::string const& text)
    {
        VXLogger::logLevelMessage("function", "file", 12, "a.b", 3000, nullptr, 0, 0, text);
        VXLogger::traceLevelMessage("function", "file", 12, "a.b", 3000, nullptr, 0, 0, text);
    }

    Lines written()
    {
        EXPECT_EQ(out.finish(), 0);
        return linesOf(contentOf(folder_.path("log")));
    }

private:
    ScratchFolder const folder_;
    std::FILE* const stream_ = std::fopen(folder_.path("log").c_str(), "w");

protected:
    LineWriter out{stream_};
};

TEST_F(LogSinks, ForPeopleWriteEachMessageOnceAndOnOneLine)
{
    mihost::HumanLines lines(out);
    mihost::setLogSink(&lines);
    say("text");
    say("two\nlines\x1b");
    EXPECT_EQ(written(), (Lines{"3000 a.b: text", "3000 a.b: two\\nlines\\x1b"}));
}

TEST_F(LogSinks, ForProgramsWriteEachCallAsAnObject)
{
    mihost::JsonLines lines(out, [](unsigned int) { return "kind"; });
    mihost::setLogSink(&lines);
    say("a \"word\"");
    std::string const rest = R"(,"function":"function","file":"file","line":12,"category":"a.b",)"
                             R"("level":3000,"message":"a \"word\""})";
    EXPECT_EQ(written(), (Lines{R"({"op":"log")" + rest, R"({"op":"trace")" + rest}));
}

TEST(LineWriter, KeepsTheFirstFailureAndWritesNothingMore)
{
    std::FILE* const full = std::fopen("/dev/full", "w");
    ASSERT_NE(full, nullptr);
    std::setvbuf(full, nullptr, _IONBF, 0);
    LineWriter out(full);
    out.write("line");
    errno = 0;
    out.write("another");
    EXPECT_EQ(errno, 0);
    EXPECT_EQ(out.finish(), ENOSPC);
    std::fclose(full);
}

TEST(LineWriter, ReportsAFailureThatShowsOnlyAtTheEnd)
{
    std::FILE* const full = std::fopen("/dev/full", "w");
    ASSERT_NE(full, nullptr);
    LineWriter out(full);
    out.write("line");
    EXPECT_EQ(out.finish(), ENOSPC);
    std::fclose(full);
}

} // namespace sinks_test
