#include "sysdata/osInfo_linux.h"

#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/LastOpened.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

#include <cerrno>
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
    Lines steps_;
    std::vector<std::size_t> bufferSizes_;
    int lockResult_ = 0;
};

TEST_F(UserCount, CountsEveryUidZeroAndTheRangeButNoSystemAccount)
{
    struct {
        std::string passwd;
        unsigned int count;
    } const cases[] = {{account("root", 0) + account("daemon", 2) + account("jdoe", 1000), 2},
                       {account("below", 499) + account("first", 500), 1},
                       {account("last", 60000) + account("above", 60001), 1},
                       {account("root", 0) + account("toor", 0), 2}};
    for (auto const& [passwd, expected] : cases)
        EXPECT_EQ(countOf(passwd), expected) << passwd;
}

TEST_F(UserCount, IsZeroWithoutAnAccountFile)
{
    EXPECT_EQ(count(), 0U);
    EXPECT_EQ(steps_, (Lines{"lock", "setpwent", "unlock"}));
}

TEST_F(UserCount, HoldsTheLockForTheWholeScan)
{
    for (int const result : {0, -1}) {
        lockResult_ = result;
        steps_.clear();
        bufferSizes_.clear();
        EXPECT_EQ(countOf(account("root", 0) + account("jdoe", 1000)), 2U);
        EXPECT_EQ(steps_, (Lines{"lock", "setpwent", "read", "read", "read", "unlock"}));
        EXPECT_EQ(bufferSizes_, std::vector<std::size_t>(3, 4096));
    }
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
    EXPECT_EQ(steps_, (Lines{"lock", "setpwent", "read", "read", "unlock"}));
}

TEST_F(UserCount, ClosesTheAccountFileBeforeItReleasesTheLock)
{
    files_.write("/etc/passwd", account("root", 0));
    LastOpened const file;
    bool openAtRelease = true;
    libc::hooks().ulckpwdf = [&] {
        openAtRelease = isOpen(file.descriptor());
        return 0;
    };
    NQ::minMaxId::Instance();
    count();
    EXPECT_NE(file.descriptor(), -1);
    EXPECT_FALSE(openAtRelease);
}

} // namespace os_user_count_test
