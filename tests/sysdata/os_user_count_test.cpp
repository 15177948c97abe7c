#include "sysdata/osInfo_linux.h"

#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <pwd.h>
#include <string>
#include <vector>

namespace os_user_count_test
{

using NQ::OsInfo;

constexpr char const* ranges = "UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\n";

/** A machine with its own accounts, whose account lock only records its calls. */
class UserCount : public testing::Test
{
protected:
    UserCount()
    {
        files_.write("/etc/login.defs", ranges);
        libc::hooks().lckpwdf = [this] {
            steps_.emplace_back("lock");
            return lockResult_;
        };
        libc::hooks().ulckpwdf = [this] {
            steps_.emplace_back("unlock");
            return 0;
        };
        libc::hooks().setpwent = [this] { steps_.emplace_back("setpwent"); };
        libc::hooks().endpwent = [this] { steps_.emplace_back("endpwent"); };
        libc::hooks().fgetpwent_r = [this](FILE* stream, passwd* entry, char* buffer,
                                           std::size_t size, passwd** found) {
            steps_.emplace_back("read");
            bufferSizes_.push_back(size);
            return interpose::real(fgetpwent_r)(stream, entry, buffer, size, found);
        };
    }

    unsigned int count()
    {
        unsigned int out = 4711;
        EXPECT_TRUE(OsInfo().getUserCount(out));
        return out;
    }

    unsigned int countOf(std::string const& passwd)
    {
        files_.write("/etc/passwd", passwd);
        return count();
    }

    FakeFiles const files_;
    libc::HookGuard const guard_;
    std::vector<std::string> steps_;
    std::vector<std::size_t> bufferSizes_;
    int lockResult_ = 0;
};

TEST_F(UserCount, CountsRootAndTheUsersInTheRangeButNoSystemAccount)
{
    EXPECT_EQ(countOf(account("root", 0) + account("daemon", 2) + account("jdoe", 1000)), 2U);
}

TEST_F(UserCount, IncludesBothEndsOfTheRange)
{
    EXPECT_EQ(countOf(account("below", 499) + account("first", 500)), 1U);
    EXPECT_EQ(countOf(account("last", 60000) + account("above", 60001)), 1U);
}

TEST_F(UserCount, CountsEveryAccountWithUidZero)
{
    EXPECT_EQ(countOf(account("root", 0) + account("toor", 0)), 2U);
}

TEST_F(UserCount, IsZeroWithoutAnAccountFile)
{
    EXPECT_EQ(count(), 0U);
    EXPECT_EQ(steps_, (std::vector<std::string>{"lock", "setpwent", "unlock"}));
}

TEST_F(UserCount, OpensTheAccountFileInModeRo)
{
    std::vector<std::string> opened;
    auto const below = libc::hooks().fopen.answer();
    libc::hooks().fopen = [&opened, below](char const* path, char const* mode) {
        opened.push_back(std::string(path) + "|" + mode);
        return below(path, mode);
    };
    NQ::minMaxId::Instance();
    opened.clear();
    countOf(account("root", 0));
    ASSERT_EQ(opened.size(), 2U); // first the file written above
    EXPECT_EQ(opened[1], "/etc/passwd|ro");
}

TEST_F(UserCount, HoldsTheLockForTheWholeScan)
{
    countOf(account("root", 0) + account("jdoe", 1000));
    EXPECT_EQ(steps_,
              (std::vector<std::string>{"lock", "setpwent", "read", "read", "read", "unlock"}));
}

TEST_F(UserCount, ContinuesWithoutTheLock)
{
    lockResult_ = -1;
    EXPECT_EQ(countOf(account("root", 0)), 1U);
    EXPECT_EQ(steps_.back(), "unlock");
}

TEST_F(UserCount, ReadsEachLineIntoABufferOf4096Bytes)
{
    countOf(account("root", 0));
    EXPECT_EQ(bufferSizes_, (std::vector<std::size_t>{4096, 4096}));
}

TEST_F(UserCount, EndsAtALineThatDoesNotFitTheBuffer)
{
    std::string const longName(4096, 'x');
    EXPECT_EQ(countOf(account("root", 0) + account(longName, 1000) + account("jdoe", 1001)), 1U);
    EXPECT_EQ(steps_.back(), "unlock");
}

TEST_F(UserCount, EndsAtAnyError)
{
    libc::hooks().fgetpwent_r = [this](FILE* stream, passwd* entry, char* buffer, std::size_t size,
                                       passwd** found) {
        steps_.emplace_back("read");
        if (steps_.size() == 4)
            return EINVAL;
        return interpose::real(fgetpwent_r)(stream, entry, buffer, size, found);
    };
    EXPECT_EQ(countOf(account("root", 0) + account("a", 1000) + account("b", 1001)), 1U);
    EXPECT_EQ(steps_, (std::vector<std::string>{"lock", "setpwent", "read", "read", "unlock"}));
}

TEST_F(UserCount, ClosesTheAccountFileBeforeItReleasesTheLock)
{
    int descriptor = -1;
    auto const below = libc::hooks().fopen.answer();
    files_.write("/etc/passwd", account("root", 0));
    libc::hooks().fopen = [&](char const* path, char const* mode) {
        FILE* const stream = below(path, mode);
        if (std::string(path) == "/etc/passwd")
            descriptor = fileno(stream);
        return stream;
    };
    bool openAtRelease = true;
    libc::hooks().ulckpwdf = [&] {
        openAtRelease = fcntl(descriptor, F_GETFD) != -1;
        return 0;
    };
    count();
    EXPECT_NE(descriptor, -1);
    EXPECT_FALSE(openAtRelease);
}

TEST_F(UserCount, ReadsTheFileEachTime)
{
    EXPECT_EQ(countOf(account("root", 0)), 1U);
    EXPECT_EQ(countOf(account("root", 0) + account("jdoe", 1000)), 2U);
}

} // namespace os_user_count_test
