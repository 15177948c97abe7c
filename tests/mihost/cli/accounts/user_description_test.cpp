#include "mihost/cli/accounts/GroupDescription.h"
#include "mihost/cli/accounts/UserDescription.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

namespace user_description_test
{

using namespace mihost;

constexpr long today = 20000;

/** A machine with one ordinary account, jdoe, which has this shadow record. */
AccountData machineWith(std::string const& shadow)
{
    return {{{accountFile,
              {"root:x:0:0:Super:/root:/bin/sh", "jdoe:x:1000:1000:J. Doe:/home/jdoe:/bin/sh",
               "nobody:*:65534:65534:::/usr/sbin/nologin", "odd:x:none:0:::"}},
             {shadowFile, shadow.empty() ? Lines() : Lines{shadow}},
             {groupFile,
              {"root:x:0:", "jdoe:x:1000:", "wheel:x:10:root,jdoe", "crew:x:1001:jdoe,gone",
               "short:x:5"}},
             {groupShadowFile, {}}},
            LoginDefs("UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX 60000\n"),
            "",
            ""};
}

UserDescription jdoe(std::string const& shadow)
{
    return describeUser(machineWith(shadow), "jdoe").value();
}

std::string stateOf(std::string const& shadow)
{
    return accountState(jdoe(shadow), today);
}

Lines namesOf(std::vector<NamedGroup> const& groups)
{
    Lines names;
    for (NamedGroup const& group : groups)
        names.push_back(group.name);
    return names;
}

TEST(UserDescription, HasTheAccountsOwnFields)
{
    UserDescription const user = jdoe("jdoe:$y$hash:19990:1:30:7:5:20100:");
    EXPECT_EQ(user.name, "jdoe");
    EXPECT_EQ(user.id, 1000U);
    EXPECT_EQ(user.fullName, "J. Doe");
    EXPECT_EQ(user.home, "/home/jdoe");
    EXPECT_EQ(user.shell, "/bin/sh");
    EXPECT_EQ(user.password, PasswordState::Set);
    EXPECT_EQ(user.unknown, "");
    EXPECT_EQ(user.noNode, "");
}

TEST(UserDescription, NamesThePrimaryGroupAndThoseThatListTheUser)
{
    UserDescription const user = jdoe("");
    EXPECT_EQ(user.primaryGroup.name, "jdoe");
    EXPECT_EQ(namesOf(user.otherGroups), (Lines{"wheel", "crew"}));
    UserDescription const nobody = describeUser(machineWith(""), "nobody").value();
    EXPECT_EQ(nobody.primaryGroup.id, 65534U);
    EXPECT_EQ(nobody.primaryGroup.name, ""); // no such group
    EXPECT_TRUE(nobody.otherGroups.empty());
}

TEST(UserDescription, SaysWhyAnAccountHasNoNode)
{
    EXPECT_EQ(describeUser(machineWith(""), "root")->noNode, "");
    EXPECT_EQ(describeUser(machineWith(""), "nobody")->noNode, "uid 65534 is above UID_MAX 60000");
    for (char const* name : {"none", "jdo", "jdoe:x", "odd", ""})
        EXPECT_FALSE(describeUser(machineWith(""), name)) << name;
}

TEST(UserDescription, CountsTheDaysOfAgeingFromTheLastChange)
{
    PasswordAgeing const ageing = jdoe("jdoe:$y$hash:19990:1:30:7:5:20100:").ageing;
    EXPECT_EQ(ageing.changed, 19990);
    EXPECT_EQ(ageing.changeableFrom, 19991);
    EXPECT_EQ(ageing.lastValid, 20020);
    EXPECT_EQ(ageing.warnsFrom, 20013);
    EXPECT_EQ(ageing.lastActive, 20025);
    EXPECT_EQ(jdoe("jdoe:$y$hash:19990:1:30:7:5:20100:").expires, 20100);
}

TEST(UserDescription, HasTheStoredNumbersOfDays)
{
    PasswordAgeing const ageing = jdoe("jdoe:$y$hash:19990:1:99999:7:5:20100:").ageing;
    EXPECT_EQ(ageing.minDays, 1);
    EXPECT_EQ(ageing.maxDays, 99999);
    EXPECT_EQ(ageing.warnDays, 7);
    EXPECT_EQ(ageing.inactiveDays, 5);
    PasswordAgeing const none = jdoe("jdoe:$y$hash:19990:::-1:x::").ageing;
    for (auto const& days : {none.minDays, none.maxDays, none.warnDays, none.inactiveDays})
        EXPECT_FALSE(days);
}

TEST(UserDescription, HasNoDaysWithoutALimitOrALastChange)
{
    for (char const* shadow :
         {"jdoe:!:19990:::::", "jdoe:!:19990:0:99999:7:3::", "jdoe:!:19990:0:-1:7:3::",
          "jdoe:!:::30:7:3::", "jdoe:!:x:0:30:7:3::"}) {
        PasswordAgeing const ageing = jdoe(shadow).ageing;
        EXPECT_FALSE(ageing.lastValid) << shadow;
        EXPECT_FALSE(ageing.warnsFrom) << shadow;
        EXPECT_FALSE(ageing.lastActive) << shadow;
    }
}

TEST(UserDescription, KnowsWhatIsStoredForAPassword)
{
    struct Case {
        char const* stored;
        PasswordState state;
    };
    for (Case const& each :
         {Case{"$6$salt$hash", PasswordState::Set}, Case{"abcdefghijklm", PasswordState::Set},
          Case{"!$6$salt$hash", PasswordState::Locked}, Case{"!", PasswordState::Locked},
          Case{"!!", PasswordState::Locked}, Case{"*", PasswordState::Unusable},
          Case{"geheim42", PasswordState::Unusable}, Case{"", PasswordState::None}})
        EXPECT_EQ(jdoe("jdoe:" + std::string(each.stored) + ":19990::::::").password, each.state)
            << each.stored;
    UserDescription const user = describeUser(machineWith(""), "nobody").value();
    EXPECT_EQ(user.password, PasswordState::Unusable);
    EXPECT_EQ(user.unknown, "");
}

TEST(UserDescription, SaysWhyThePasswordIsUnknown)
{
    EXPECT_EQ(jdoe("").unknown, "'jdoe' has no entry in /etc/shadow");
    AccountData data = machineWith("");
    data.shadowProblem = "Permission denied";
    UserDescription const user = describeUser(data, "jdoe").value();
    EXPECT_EQ(user.unknown, "/etc/shadow cannot be read: Permission denied");
    EXPECT_EQ(user.password, PasswordState::Unknown);
    EXPECT_EQ(accountState(user, today), "");
}

TEST(AccountState, SaysWhatAgeingMeansToday)
{
    struct Case {
        char const* shadow;
        char const* state;
    };
    for (Case const& each : {
             Case{"jdoe:$y$h:19990:0:99999:7:::", "active"},
             Case{"jdoe:$y$h:19990:0:30:7:::", "active"}, // in 20 days, warned from 7 on
             Case{"jdoe:$y$h:19990:0:17:7:::", "active"},
             Case{"jdoe:$y$h:19990:0:16:7:::", "active; the password expires in 6 days"},
             Case{"jdoe:$y$h:19990:0:11:7:::", "active; the password expires in 1 day"},
             Case{"jdoe:$y$h:19990:0:10:7:::", "active; the password expires today"},
             Case{"jdoe:$y$h:19990:0:9:7:::",
                  "active; the password expired 1 day ago and must be changed at the next login"},
             Case{"jdoe:$y$h:0:0:30:7:::",
                  "active; the password must be changed at the next login"},
             Case{"jdoe:$y$h:19990:0:7:7:3::",
                  "active; the password expired 3 days ago and must be changed at the next login"},
             Case{"jdoe:$y$h:19990:0:6:7:3::", "inactive; the password expired 4 days ago"},
             Case{"jdoe:$y$h:19990:0:99999:7::20001:", "active"},
             Case{"jdoe:$y$h:19990:0:99999:7::20000:", "expired today"},
             Case{"jdoe:!:19990:0:99999:7::19999:", "expired 1 day ago"},
             Case{"jdoe:!:19990:0:9:7:::", "locked"},
             Case{"jdoe:*:19990:0:99999:7:::", "no login by password"},
             Case{"jdoe::19990:0:99999:7:::", "active"},
         })
        EXPECT_EQ(stateOf(each.shadow), each.state) << each.shadow;
}

TEST(AllowedLoginFailures, AreTheLastNumberThatFollowsDeny)
{
    EXPECT_EQ(allowedLoginFailures(""), 0);
    EXPECT_EQ(allowedLoginFailures("auth required pam_tally2.so deny=3 onerr=fail\n"), 3);
    EXPECT_EQ(allowedLoginFailures("# deny=4\na deny=5 deny=6\nb deny=x\n"), 5);
}

TEST(GroupDescription, SeparatesPrimaryFromListedMembers)
{
    auto const crew = describeGroup(machineWith(""), "crew").value();
    EXPECT_EQ(crew.id, 1001U);
    EXPECT_EQ(crew.primaryMembers, Lines());
    ASSERT_EQ(crew.listedMembers.size(), 2U);
    EXPECT_EQ(crew.listedMembers[0].name, "jdoe");
    EXPECT_TRUE(crew.listedMembers[0].hasAccount);
    EXPECT_EQ(crew.listedMembers[1].name, "gone");
    EXPECT_FALSE(crew.listedMembers[1].hasAccount);
    EXPECT_EQ(crew.noNode, "");
    auto const primary = describeGroup(machineWith(""), "jdoe").value();
    EXPECT_EQ(primary.primaryMembers, Lines{"jdoe"});
    EXPECT_TRUE(primary.listedMembers.empty());
}

TEST(GroupDescription, SaysWhyAGroupHasNoNode)
{
    EXPECT_EQ(describeGroup(machineWith(""), "wheel")->noNode, "gid 10 is below GID_MIN 1000");
    EXPECT_EQ(describeGroup(machineWith(""), "root")->noNode, "");
    EXPECT_EQ(describeGroup(machineWith(""), "short")->noNode, "gid 5 is below GID_MIN 1000");
    EXPECT_FALSE(describeGroup(machineWith(""), "none"));
}

} // namespace user_description_test
