#include "util/MyProcess.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>
#include <vector>

namespace my_process_test
{

using NQ::MyProcess;

/** Returns the streams of popen one after the other and records which of them are closed. */
class Pipes
{
public:
    Pipes()
    {
        libc::hooks().popen = [this](char const* command, char const* mode) -> FILE* {
            asked.push_back(std::string(command) + "|" + mode);
            if (refuse)
                return nullptr;
            opened.push_back(std::tmpfile());
            return opened.back();
        };
        libc::hooks().pclose = [this](FILE* stream) {
            closed.push_back(stream);
            return exitStatus;
        };
    }

    ~Pipes()
    {
        for (FILE* stream : opened)
            std::fclose(stream);
    }

    Pipes(Pipes const&) = delete;
    Pipes& operator=(Pipes const&) = delete;

    Lines asked;
    std::vector<FILE*> opened;
    std::vector<FILE*> closed;
    bool refuse = false;
    int exitStatus = 0;
};

TEST(MyProcess, ClosesItsPipeWhenDestroyed)
{
    Pipes pipes;
    {
        MyProcess process;
        FILE* const stream = process.mypopen("lsmod", "r");
        ASSERT_EQ(pipes.opened, std::vector<FILE*>{stream});
        EXPECT_TRUE(pipes.closed.empty());
    }
    EXPECT_EQ(pipes.closed, pipes.opened);
    EXPECT_EQ(pipes.asked, Lines{"lsmod|r"});
}

TEST(MyProcess, ClosesNothingWhenNotStarted)
{
    Pipes pipes;
    {
        MyProcess const never;
        pipes.refuse = true;
        MyProcess refused;
        EXPECT_EQ(refused.mypopen("cat", "w"), nullptr);
    }
    EXPECT_TRUE(pipes.closed.empty());
    EXPECT_EQ(pipes.asked, Lines{"cat|w"});
}

TEST(MyProcess, LosesTheFirstStreamOfTwoStartsUnclosed)
{
    Pipes pipes;
    {
        MyProcess process;
        process.mypopen("first", "r");
        FILE* const second = process.mypopen("second", "r");
        EXPECT_EQ(second, pipes.opened.at(1));
    }
    EXPECT_EQ(pipes.closed, std::vector<FILE*>{pipes.opened.at(1)});
}

TEST(MyProcess, ForgetsTheFirstStreamEvenWhenTheSecondStartFails)
{
    Pipes pipes;
    {
        MyProcess process;
        process.mypopen("first", "r");
        pipes.refuse = true;
        EXPECT_EQ(process.mypopen("second", "r"), nullptr);
    }
    EXPECT_TRUE(pipes.closed.empty());
}

TEST(MyProcess, RunsTwoCommandsAtOnceInTwoObjects)
{
    Pipes pipes;
    {
        MyProcess outer;
        outer.mypopen("lsmod", "r");
        {
            MyProcess inner;
            inner.mypopen("modinfo", "r");
        }
        EXPECT_EQ(pipes.closed, std::vector<FILE*>{pipes.opened.at(1)});
    }
    EXPECT_EQ(pipes.closed, (std::vector<FILE*>{pipes.opened.at(1), pipes.opened.at(0)}));
}

TEST(MyProcess, IgnoresTheExitStatusAndLogsNothing)
{
    Recording const log;
    Pipes pipes;
    pipes.exitStatus = -1;
    {
        MyProcess process;
        process.mypopen("false", "r");
        pipes.refuse = true;
        process.mypopen("false", "r");
    }
    EXPECT_TRUE(log.records().empty());
}

TEST(MyProcess, YieldsTheCommandsOutputLineByLine)
{
    MyProcess process;
    FILE* const stream = process.mypopen("echo one; echo two; exit 3", "r");
    ASSERT_NE(stream, nullptr);
    char line[512];
    EXPECT_STREQ(std::fgets(line, sizeof line, stream), "one\n");
    EXPECT_STREQ(std::fgets(line, sizeof line, stream), "two\n");
    EXPECT_EQ(std::fgets(line, sizeof line, stream), nullptr);
}

TEST(MyProcess, HasTheSizeOfOneStreamAndCannotBeCopied)
{
    EXPECT_EQ(sizeof(MyProcess), sizeof(FILE*));
    EXPECT_FALSE(std::is_copy_constructible_v<MyProcess>);
    EXPECT_FALSE(std::is_copy_assignable_v<MyProcess>);
}

} // namespace my_process_test
