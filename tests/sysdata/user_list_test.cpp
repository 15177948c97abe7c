#include "sysdata/userInfo_linux.h"

#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <locale>
#include <new>
#include <pwd.h>
#include <shadow.h>
#include <string>
#include <utility>
#include <vector>

namespace user_list_test
{

using NQ::userInfo;

std::string shadow(std::string const& name, std::string const& password)
{
    return name + ":" + password + ":1:2:3:4:5:6:\n";
}

/** A machine with its own accounts; every step of a listing is recorded. */
class UserListing : public testing::Test
{
protected:
    UserListing()
    {
        useZone("UTC0");
        files_.write("/etc/login.defs", "UID_MIN 500\nUID_MAX 60000\n");
        NQ::minMaxId::Instance();
        libc::hooks().lckpwdf = [this] {
            steps_.emplace_back("lock");
            return lockResult_;
        };
        libc::hooks().ulckpwdf = [this] {
            steps_.emplace_back("unlock");
            for (int const descriptor : opened_)
                openAtRelease_ += isOpen(descriptor) ? 1 : 0;
            return 0;
        };
        auto const below = libc::hooks().fopen.answer();
        libc::hooks().fopen = [this, below](char const* path, char const* mode) {
            FILE* const stream = below(path, mode);
            std::string const file = path;
            if (noting_)
                steps_.push_back(file + ' ' + mode);
            if (noting_ && stream && file != "/etc/pam.d/login")
                opened_.push_back(fileno(stream));
            return stream;
        };
    }

    static bool isOpen(int descriptor)
    {
        return fcntl(descriptor, F_GETFD) != -1;
    }

    std::vector<userInfo> list()
    {
        std::vector<userInfo> users;
        noting_ = true;
        NQ::getUserInfo(users);
        noting_ = false;
        return users;
    }

    Lines names()
    {
        Lines names;
        for (userInfo& user : list())
            names.push_back(user.getUserName());
        return names;
    }

    FakeFiles const files_;
    bool noting_ = false;
    int lockResult_ = 0;
    Lines steps_;
    std::vector<int> opened_;
    int openAtRelease_ = 0;
};

TEST_F(UserListing, KeepsUidZeroAndTheRangeInTheFilesOrder)
{
    files_.write("/etc/passwd", account("zoe", 3000) + account("root", 0) + account("daemon", 2) +
                                    account("abe", 1000) + account("above", 60001) +
                                    account("last", 60000) + account("below", 499) +
                                    account("first", 500));
    EXPECT_EQ(names(), (Lines{"zoe", "root", "abe", "last", "first"}));
}

TEST_F(UserListing, ReplacesWhatTheListHeldBefore)
{
    std::vector<userInfo> users(3, userInfo("old"));
    NQ::getUserInfo(users);
    EXPECT_TRUE(users.empty()); // the account files are not written yet
    files_.write("/etc/passwd", account("jdoe", 1000));
    users.resize(3);
    std::vector<std::size_t> atOpening;
    libc::hooks().fopen.watch([&](char const*, char const*) { atOpening.push_back(users.size()); });
    NQ::getUserInfo(users);
    EXPECT_EQ(atOpening, std::vector<std::size_t>(3, 0)); // emptied first
    ASSERT_EQ(users.size(), 1U);
    EXPECT_EQ(users.front().getUserName(), "jdoe");
}

TEST_F(UserListing, ReleasesTheLockBeforeItClosesTheFiles)
{
    files_.write("/etc/passwd", account("root", 0) + account("daemon", 2) + account("jdoe", 1000));
    files_.write("/etc/shadow", "");
    for (int const result : {0, -1}) {
        lockResult_ = result;
        steps_.clear();
        opened_.clear();
        openAtRelease_ = 0;
        EXPECT_EQ(names(), (Lines{"root", "jdoe"}));
        // The rules are read for each listed user.
        EXPECT_EQ(steps_, (Lines{"/etc/passwd ro", "/etc/shadow ro", "lock", "/etc/pam.d/login r",
                                 "/etc/pam.d/login r", "unlock"}));
        EXPECT_EQ(opened_.size(), 2U);
        EXPECT_EQ(openAtRelease_, 2);
        for (int const descriptor : opened_)
            EXPECT_FALSE(isOpen(descriptor));
    }
}

TEST_F(UserListing, ReleasesLockAndFilesWhenAnExceptionPasses)
{
    files_.write("/etc/passwd", account("root", 0) + account("jdoe", 1000));
    files_.write("/etc/shadow", "");
    libc::hooks().fgetpwent_r = [](FILE*, passwd*, char*, std::size_t, passwd**) -> int {
        throw std::bad_alloc();
    };
    EXPECT_THROW(list(), std::bad_alloc);
    EXPECT_EQ(steps_, (Lines{"/etc/passwd ro", "/etc/shadow ro", "lock", "unlock"}));
    for (int const descriptor : opened_)
        EXPECT_FALSE(isOpen(descriptor));
}

TEST_F(UserListing, EndsAtAnyErrorAndReleasesTheLock)
{
    files_.write("/etc/passwd", account("a", 1000) + account("b", 1001) + account("c", 1002));
    libc::hooks().fgetpwent_r.failAt(2);
    EXPECT_EQ(names(), Lines{"a"});
    EXPECT_EQ(libc::hooks().fgetpwent_r.stopCounting(), 2U);
    EXPECT_EQ(steps_.back(), "unlock");
}

TEST_F(UserListing, ReadsLinesIntoBuffersOf4096Bytes)
{
    files_.write("/etc/passwd", account("a", 1000));
    files_.write("/etc/shadow", shadow("a", "A"));
    std::vector<std::size_t> sizes;
    libc::hooks().fgetpwent_r.watch(
        [&sizes](FILE*, passwd*, char*, std::size_t size, passwd**) { sizes.push_back(size); });
    libc::hooks().fgetspent_r.watch(
        [&sizes](FILE*, spwd*, char*, std::size_t size, spwd**) { sizes.push_back(size); });
    list();
    EXPECT_EQ(sizes, std::vector<std::size_t>(3, 4096));
}

Lines passwordsOf(std::vector<userInfo> users)
{
    Lines passwords;
    for (userInfo& user : users)
        passwords.push_back(user.getUserPassword());
    return passwords;
}

TEST_F(UserListing, HasNoShadowFactsAfterALineThatDoesNotFit)
{
    files_.write("/etc/passwd", account("a", 1000) + account("b", 1001));
    std::string const fitting(4060, 'p');
    files_.write("/etc/shadow", shadow("a", fitting) + shadow("b", "q"));
    EXPECT_EQ(passwordsOf(list()), (Lines{fitting, "q"}));
    files_.write("/etc/shadow", shadow("a", std::string(4100, 'p')) + shadow("b", "q"));
    EXPECT_EQ(passwordsOf(list()), (Lines{"", ""}));
}

TEST_F(UserListing, SearchesTheShadowFileFromTheLastEntryOn)
{
    files_.write("/etc/passwd",
                 account("a", 1000) + account("b", 1001) + account("c", 1002) + account("d", 1003));
    files_.write("/etc/shadow", shadow("x", "x") + shadow("a", "A") + shadow("b", "B") +
                                    shadow("d", "D") + shadow("c", "C"));
    EXPECT_EQ(passwordsOf(list()), (Lines{"A", "B", "C", ""}));
}

TEST_F(UserListing, LooksUpWholeNamesAndThoseOfListedAccountsOnly)
{
    files_.write("/etc/passwd", account("daemon", 2) + account("ann", 1000));
    files_.write("/etc/shadow", shadow("anna", "X") + shadow("an", "Y") + shadow("ann", "A") +
                                    shadow("daemon", "*"));
    EXPECT_EQ(passwordsOf(list()), Lines{"A"});
}

TEST_F(UserListing, HasEmptyTextsForARemoteDatabase)
{
    files_.write("/etc/passwd", account("root", 0) + "+\n");
    std::vector<userInfo> users = list();
    ASSERT_EQ(users.size(), 2U);
    EXPECT_EQ(users[1].getUserName(), "+");
    EXPECT_EQ(users[1].getUserId(), "0");
    EXPECT_EQ(users[1].getUserFullName(), "");
    EXPECT_EQ(users[1].getUserHomeDir(), "");
    EXPECT_EQ(users[1].getUserScriptPath(), "");
}

TEST_F(UserListing, WritesIdsInPlainDecimalWhateverTheHostsLocale)
{
    struct Grouped : std::numpunct<char> {
        std::string do_grouping() const override
        {
            return "\3";
        }
    };
    files_.write("/etc/passwd", "jdoe:x:60000:4294967294:::\n");
    std::locale const before =
        std::locale::global(std::locale(std::locale::classic(), new Grouped));
    std::vector<userInfo> users = list();
    std::locale::global(before);
    ASSERT_EQ(users.size(), 1U);
    EXPECT_EQ(users.front().getUserId(), "60000");
    EXPECT_EQ(users.front().getGroupId(), "4294967294");
}

TEST_F(UserListing, SetsAllFactsOfAUserInAFixedOrder)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    files_.write("/etc/shadow", shadow("jdoe", "secret"));
    Recording const log;
    list();
    Lines expected{"getUserInfo: entry"};
    auto const plain = [&expected](std::string const& name) {
        expected.push_back(name + ": entry");
        expected.push_back(name + ": exit");
    };
    for (char const* name : {"setUserId", "setGroupId", "setUserFullName", "setUserHomeDir",
                             "setUserScriptPath", "setUserAcctDisabled", "setUserPassword"})
        plain(name);
    for (char const* line : {"setLstPwdChg: entry", "ito_time_t: entry", "to_time_t: entry",
                             "to_time_t: exit", "ito_time_t: exit", "setLstPwdChg: exit"})
        expected.emplace_back(line);
    for (char const* name : {"setPwdMinDays", "setPwdMaxDays", "setPwdWarnDays", "setPwdExpDays"})
        plain(name);
    expected.emplace_back("setPwdInactDays: entry");
    plain("to_time_t");
    expected.emplace_back("setPwdInactDays: exit");
    plain("setPasswordHistoryDepth");
    plain("setMaxLoginFailures");
    expected.emplace_back("getUserInfo: exit");
    EXPECT_EQ(log.texts(), expected);
}

TEST_F(UserListing, LogsAnUnparsableRuleUnderItsOwnNameAsAnError)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    files_.write("/etc/pam.d/login", "deny=x\n");
    Recording const log;
    list();
    EXPECT_EQ(log.texts(6000), Lines{"Invalid format: line = deny=x"});
    for (LogRecord const& record : log.records())
        if (record.level == 6000) {
            EXPECT_EQ(record.function, "getUserInfo");
            EXPECT_EQ(record.file, "userInfo_linux");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.UserInfo");
        }
}

TEST_F(UserListing, StartsTheFailuresAtZeroForEachUser)
{
    files_.write("/etc/passwd", account("jdoe", 1000) + account("mary", 1001));
    for (userInfo& user : list())
        EXPECT_EQ(user.getMaxLoginFailures(), 0); // without rules

    // The rules change while the accounts are read: the second user has none.
    bool first = true;
    auto const below = libc::hooks().fopen.answer();
    libc::hooks().fopen = [&](char const* path, char const* mode) {
        if (path == std::string("/etc/pam.d/login"))
            files_.write(path, std::exchange(first, false) ? "deny=4\n" : "none\n");
        return below(path, mode);
    };
    std::vector<userInfo> users = list();
    ASSERT_EQ(users.size(), 2U);
    EXPECT_EQ(users[0].getMaxLoginFailures(), 4);
    EXPECT_EQ(users[1].getMaxLoginFailures(), 0);
}

TEST_F(UserListing, ReadsTheFailuresAsADecimalNumber)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    struct {
        char const* rules;
        long failures;
    } const cases[] = {{"", 0},
                       {"auth required pam_unix.so\n", 0},
                       {"deny=x\n", 0},
                       {"deny=99\ndeny=x\ndeny=8\n", 8},
                       {"deny=99\ndeny=010\n", 10},
                       {"deny=99\ndeny=0x10\n", 0},
                       {"deny=99\ndeny=-3\n", -3},
                       {"deny=99\ndeny= 5\n", 5},
                       {"deny=99\ndeny=7x\n", 7}};
    for (auto const& [rules, failures] : cases) {
        files_.write("/etc/pam.d/login", rules);
        EXPECT_EQ(list().at(0).getMaxLoginFailures(), failures) << rules;
    }
}

TEST_F(UserListing, ReadsRulesOfAnyLengthToTheirEnd)
{
    files_.write("/etc/passwd", account("jdoe", 1000) + account("mary", 1001));
    for (std::size_t const length : {0U, 8191U, 8192U, 100000U}) {
        files_.write("/etc/pam.d/login", "deny=1\n" + std::string(length, '#') + "\ndeny=2");
        for (userInfo& user : list())
            EXPECT_EQ(user.getMaxLoginFailures(), 2) << length;
    }
}

TEST_F(UserListing, OpensNothingElseWithoutAnAccountFile)
{
    files_.write("/etc/shadow", shadow("root", "x"));
    EXPECT_TRUE(list().empty());
    EXPECT_EQ(steps_, Lines{"/etc/passwd ro"});
}

} // namespace user_list_test
