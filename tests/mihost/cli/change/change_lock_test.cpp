#include "mihost/cli/change/ChangeLock.h"

#include "mihost/cli/system/Failure.h"
#include "tests/support/ScratchFolder.h"

#include <array>
#include <atomic>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <optional>
#include <sys/stat.h>
#include <thread>

namespace change_lock_test
{

using mihost::ChangeLock;
using mihost::Failure;
using std::chrono::hours;
using std::chrono::milliseconds;

constexpr ChangeLock::Patience none{milliseconds(0), milliseconds(0)};
constexpr ChangeLock::Patience endless{milliseconds(0), hours(24)};

class TheChangeLock : public testing::Test
{
protected:
    std::string problem() const
    {
        try {
            ChangeLock const lock(file, none);
        } catch (Failure const& failure) {
            EXPECT_EQ(failure.code(), mihost::Failed);
            return failure.what();
        }
        return "locked";
    }

    ScratchFolder folder;
    std::string const file = folder.path("lock");
};

/** Redirects standard error into a pipe while it exists, and reads it. */
class ReadStandardError
{
public:
    ReadStandardError() : before_(dup(STDERR_FILENO))
    {
        EXPECT_EQ(pipe2(ends_.data(), O_CLOEXEC), 0);
        dup2(ends_[1], STDERR_FILENO);
    }
    ~ReadStandardError()
    {
        dup2(before_, STDERR_FILENO);
        for (int const descriptor : {before_, ends_[0], ends_[1]})
            close(descriptor);
    }
    std::string line() const
    {
        std::string text;
        for (char byte = 0; byte != '\n' && read(ends_[0], &byte, 1) == 1;)
            text += byte;
        return text;
    }

private:
    int before_;
    std::array<int, 2> ends_{};
};

TEST_F(TheChangeLock, IsHeldByOneAtATimeAndReleased)
{
    {
        ChangeLock const lock(file, none);
        EXPECT_NE(problem(), "locked");
    }
    EXPECT_EQ(problem(), "locked");
}

TEST_F(TheChangeLock, GivesUpAtTheLimitAndSaysWhatToDo)
{
    ChangeLock const lock(file, none);
    EXPECT_EQ(problem(), "waiting for the change lock: another mihost still holds it (try again, "
                         "or raise --lock-timeout; 'fuser " +
                             file + "' shows the process)");
}

TEST_F(TheChangeLock, SaysWhatItWaitsForUntilItIsFree)
{
    std::optional<ChangeLock> first(std::in_place, file, none);
    ReadStandardError const standardError;
    std::atomic<bool> isLocked = false;
    std::thread second([&] {
        ChangeLock const lock(file, endless);
        isLocked = true;
    });
    EXPECT_EQ(standardError.line(), "mihost: waiting for another mihost to finish its change\n");
    EXPECT_FALSE(isLocked);
    first.reset();
    second.join();
    EXPECT_TRUE(isLocked);
}

TEST_F(TheChangeLock, CanBeOpenedOnlyByItsOwner)
{
    ChangeLock const lock(file, none);
    struct stat status {
    };
    ASSERT_EQ(stat(file.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0600U);
}

TEST_F(TheChangeLock, IsNotPassedOnToCommands)
{
    ChangeLock const lock(file, none);
    std::string const look = "ls -l /proc/self/fd | grep -q '" + file + "'";
    EXPECT_NE(std::system(look.c_str()), 0);
}

TEST_F(TheChangeLock, FollowsNoLinkAndSaysWhatIsWrong)
{
    std::filesystem::create_symlink("elsewhere", file);
    EXPECT_EQ(problem(), "cannot lock " + file + ": Too many levels of symbolic links");
    EXPECT_FALSE(std::filesystem::exists(folder.path("elsewhere")));
}

} // namespace change_lock_test
