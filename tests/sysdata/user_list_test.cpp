#include "sysdata/userInfo_linux.h"

#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
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
    libc::HookGuard const guard_;
    bool noting_ = false;
    int lockResult_ = 0;
    Lines steps_;
    std::vector<int> opened_;
    int openAtRelease_ = 0;
};

TEST_F(UserListing, KeepsUidZeroAndOmitsSystemAccounts)
{
    files_.write("/etc/passwd", account("root", 0) + account("daemon", 2) + account("jdoe", 1000));
    EXPECT_EQ(names(), (Lines{"root", "jdoe"}));
}

TEST_F(UserListing, KeepsAnAccountWithUidAtTheMaximum)
{
    files_.write("/etc/passwd", account("above", 60001) + account("last", 60000));
    EXPECT_EQ(names(), Lines{"last"});
}

TEST_F(UserListing, KeepsAnAccountWithUidAtTheMinimum)
{
    files_.write("/etc/passwd", account("below", 499) + account("first", 500));
    EXPECT_EQ(names(), Lines{"first"});
}

TEST_F(UserListing, FollowsTheOrderOfTheAccountFile)
{
    files_.write("/etc/passwd", account("zoe", 3000) + account("root", 0) + account("abe", 1000));
    EXPECT_EQ(names(), (Lines{"zoe", "root", "abe"}));
}

TEST_F(UserListing, ReplacesWhatTheListHeldBefore)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    std::vector<userInfo> users(3, userInfo("old"));
    NQ::getUserInfo(users);
    ASSERT_EQ(users.size(), 1U);
    EXPECT_EQ(users.front().getUserName(), "jdoe");
}

TEST_F(UserListing, EmptiesTheListWithoutAnAccountFile)
{
    std::vector<userInfo> users(3, userInfo("old"));
    NQ::getUserInfo(users);
    EXPECT_TRUE(users.empty());
    EXPECT_EQ(steps_, Lines{});
}

TEST_F(UserListing, ReadsTheLoginRulesForEachKeptUser)
{
    files_.write("/etc/passwd", account("root", 0) + account("daemon", 2) + account("jdoe", 1000));
    files_.write("/etc/shadow", "");
    list();
    EXPECT_EQ(steps_, (Lines{"/etc/passwd ro", "/etc/shadow ro", "lock", "/etc/pam.d/login r",
                             "/etc/pam.d/login r", "unlock"}));
}

TEST_F(UserListing, ReleasesTheLockBeforeItClosesTheFiles)
{
    files_.write("/etc/passwd", account("root", 0));
    files_.write("/etc/shadow", "");
    list();
    EXPECT_EQ(opened_.size(), 2U);
    EXPECT_EQ(openAtRelease_, 2);
    for (int const descriptor : opened_)
        EXPECT_FALSE(isOpen(descriptor));
}

TEST_F(UserListing, ContinuesWithoutTheLock)
{
    lockResult_ = -1;
    files_.write("/etc/passwd", account("root", 0));
    EXPECT_EQ(names(), Lines{"root"});
    EXPECT_EQ(steps_.back(), "unlock");
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
    int reads = 0;
    libc::hooks().fgetpwent_r = [&reads](FILE* stream, passwd* entry, char* line, std::size_t size,
                                         passwd** found) {
        return ++reads == 2 ? EINVAL
                            : interpose::real(fgetpwent_r)(stream, entry, line, size, found);
    };
    EXPECT_EQ(names(), Lines{"a"});
    EXPECT_EQ(reads, 2);
    EXPECT_EQ(steps_.back(), "unlock");
}

TEST_F(UserListing, ReadsAccountLinesIntoABufferOf4096Bytes)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    std::vector<std::size_t> sizes;
    libc::hooks().fgetpwent_r = [&sizes](FILE* stream, passwd* entry, char* line, std::size_t size,
                                         passwd** found) {
        sizes.push_back(size);
        return interpose::real(fgetpwent_r)(stream, entry, line, size, found);
    };
    list();
    EXPECT_EQ(sizes, (std::vector<std::size_t>{4096, 4096}));
}

std::string shadow(std::string const& name, std::string const& password)
{
    return name + ":" + password + ":1:2:3:4:5:6:\n";
}

Lines passwordsOf(std::vector<userInfo> users)
{
    Lines passwords;
    for (userInfo& user : users)
        passwords.push_back(user.getUserPassword());
    return passwords;
}

TEST_F(UserListing, ReadsShadowLinesIntoABufferOf4096Bytes)
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

TEST_F(UserListing, HasNoShadowFactsAfterAMissingUser)
{
    files_.write("/etc/passwd", account("a", 1000) + account("b", 1001) + account("c", 1002));
    files_.write("/etc/shadow", shadow("a", "A") + shadow("c", "C"));
    std::vector<userInfo> users = list();
    ASSERT_EQ(users.size(), 3U);
    EXPECT_EQ(passwordsOf(users), (Lines{"A", "", ""}));
    EXPECT_EQ(users[2].getPwdMinDays(), 0U);
    EXPECT_EQ(users[2].getPwdMaxDays(), 0U);
    EXPECT_EQ(users[2].getPwdWarnDays(), 0U);
    EXPECT_EQ(users[2].getPwdExpDays(), 0U);
    EXPECT_EQ(users[2].getPwdInactDays(), 0U);
    EXPECT_EQ(users[2].getLstPwdChg(), 0U);
}

TEST_F(UserListing, LooksUpNoShadowEntryOfOmittedAccounts)
{
    files_.write("/etc/passwd", account("daemon", 2) + account("a", 1000));
    files_.write("/etc/shadow", shadow("a", "A") + shadow("daemon", "*"));
    EXPECT_EQ(passwordsOf(list()), Lines{"A"});
}

TEST_F(UserListing, ReadsEachShadowFieldAsItsOwnFact)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    files_.write("/etc/shadow", "jdoe:secret:10:20:30:40:50:60:\n");
    std::vector<userInfo> users = list();
    ASSERT_EQ(users.size(), 1U);
    userInfo& user = users.front();
    EXPECT_EQ(user.getUserPassword(), "secret");
    EXPECT_EQ(user.getLstPwdChg(), 10U * 86400);
    EXPECT_EQ(user.getPwdMinDays(), 20U);
    EXPECT_EQ(user.getPwdMaxDays(), 30U);
    EXPECT_EQ(user.getPwdWarnDays(), 40U);
    EXPECT_EQ(user.getPwdExpDays(), 50U);
    EXPECT_EQ(user.getPwdInactDays(), 60U * 86400);
    EXPECT_EQ(user.getPasswordHistoryDepth(), 0);
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
    std::vector<LogRecord> records = log.records();
    records.erase(std::remove_if(records.begin(), records.end(),
                                 [](LogRecord const& record) { return record.level != 6000; }),
                  records.end());
    ASSERT_EQ(records.size(), 2U); // the level log and the trace log
    for (LogRecord const& record : records) {
        EXPECT_EQ(record.text, "Invalid format: line = deny=x");
        EXPECT_EQ(record.function, "getUserInfo");
        EXPECT_EQ(record.file, "userInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.UserInfo");
    }
}

TEST_F(UserListing, HasZeroFailuresIfTheRulesNameNoNumber)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    for (char const* rules : {"", "auth required pam_unix.so\n", "deny=x\n"}) {
        files_.write("/etc/pam.d/login", rules);
        for (userInfo& user : list())
            EXPECT_EQ(user.getMaxLoginFailures(), 0) << rules;
    }
}

TEST_F(UserListing, StartsTheFailuresAtZeroForEachUser)
{
    files_.write("/etc/passwd", account("jdoe", 1000) + account("mary", 1001));
    files_.write("/etc/pam.d/login", "deny=4\n");
    for (userInfo& user : list())
        EXPECT_EQ(user.getMaxLoginFailures(), 4);
    files_.write("/etc/pam.d/login", "auth required pam_unix.so\n");
    for (userInfo& user : list())
        EXPECT_EQ(user.getMaxLoginFailures(), 0);
    files_.remove("/etc/pam.d/login");
    for (userInfo& user : list())
        EXPECT_EQ(user.getMaxLoginFailures(), 0);

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
    for (auto const& [rule, failures] : {std::pair{"deny=010", 10L},
                                         {"deny=0x10", 0L},
                                         {"deny=-3", -3L},
                                         {"deny= 5", 5L},
                                         {"deny=7x", 7L}}) {
        files_.write("/etc/pam.d/login", std::string("deny=99\n") + rule + "\n");
        std::vector<userInfo> users = list();
        ASSERT_EQ(users.size(), 1U);
        EXPECT_EQ(users[0].getMaxLoginFailures(), failures) << rule;
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

TEST_F(UserListing, SeesAChangeOfTheFilesTheNextTime)
{
    files_.write("/etc/passwd", account("jdoe", 1000));
    EXPECT_EQ(names(), Lines{"jdoe"});
    files_.write("/etc/passwd", account("jdoe", 1000) + account("new", 1001));
    EXPECT_EQ(names(), (Lines{"jdoe", "new"}));
}

TEST_F(UserListing, PassesTheShadowReaderABufferOf4096Bytes)
{
    files_.write("/etc/passwd", account("a", 1000));
    files_.write("/etc/shadow", shadow("a", "A"));
    std::vector<std::size_t> sizes;
    libc::hooks().fgetspent_r = [&sizes](FILE* stream, spwd* entry, char* line, std::size_t size,
                                         spwd** found) {
        sizes.push_back(size);
        return interpose::real(fgetspent_r)(stream, entry, line, size, found);
    };
    list();
    EXPECT_EQ(sizes, std::vector<std::size_t>{4096});
}

TEST_F(UserListing, ComparesWholeNamesWithTheShadowFile)
{
    files_.write("/etc/passwd", account("ann", 1000));
    files_.write("/etc/shadow", shadow("anna", "X") + shadow("an", "Y") + shadow("ann", "A"));
    EXPECT_EQ(passwordsOf(list()), Lines{"A"});
}

TEST_F(UserListing, OpensNothingElseWithoutAnAccountFile)
{
    files_.write("/etc/shadow", shadow("root", "x"));
    EXPECT_TRUE(list().empty());
    EXPECT_EQ(steps_, Lines{"/etc/passwd ro"});
}

} // namespace user_list_test
