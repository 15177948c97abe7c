// `mihost user NAME` and `mihost group NAME`.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <ctime>

namespace account_views_test
{

class AccountViews : public testing::Test
{
protected:
    AccountViews()
    {
        machine::lay("small");
        machine::write("/etc/passwd", machine::read("/etc/passwd") +
                                          "nobody:x:65534:65534:\x1b[2J:/none:/usr/sbin/nologin\n");
        machine::write("/etc/group", "root:x:0:\njdoe:x:1000:\ncrew:x:1001:jdoe,gone\n");
        machine::write("/etc/pam.d/login", "auth required pam_tally2.so deny=3\n");
    }
};

TEST_F(AccountViews, ShowOneUserAsTextAndAsJson)
{
    Outcome outcome{};
    Json user;
    auto const today = [] { return std::time(nullptr) / 86400; };
    for (std::time_t day = 0; day != today();) { // again if the day ended
        day = today();
        machine::write("/etc/shadow", "root:*:19000:0:99999:7:::\njdoe:$6$salt$hash:" +
                                          std::to_string(day - 10) + ":0:22:14:::\n");
        outcome = mihostRun({"user", "jdoe"});
        user = mihostJson({"user", "jdoe"});
    }
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    for (char const* line : {
             "User                  jdoe\n",
             "Full name             J. Doe\n",
             "UID                   1000\n",
             "Primary group         jdoe (1000)\n",
             "Other groups          crew (1001)\n",
             "Home directory        /home/jdoe\n",
             "Login shell           /bin/sh\n",
             "State                 active; the password expires in 12 days\n",
             "Password              set\n",
             "Active until          no limit\n",
             "Account expires       never\n",
             "Login failures        3 allowed\n",
             "Node                  user:jdoe\n",
         })
        EXPECT_TRUE(holds(outcome.out, line));
    EXPECT_TRUE(holds(outcome.out, " (10 days ago)\n"));
    EXPECT_TRUE(holds(outcome.out, " (in 12 days)\n"));
    EXPECT_FALSE(holds(outcome.out, "hash"));
    EXPECT_EQ(user["uid"], 1000);
    EXPECT_EQ(user["primary-group"], (Json{{"name", "jdoe"}, {"gid", 1000}}));
    EXPECT_EQ(user["other-groups"], Json::array({{{"name", "crew"}, {"gid", 1001}}}));
    EXPECT_EQ(user["state"], "active; the password expires in 12 days");
    EXPECT_EQ(user["password"], "set");
    EXPECT_EQ(user["password-days-left"], 12);
    EXPECT_EQ(user["min-days"], 0);
    EXPECT_EQ(user["max-days"], 22);
    EXPECT_EQ(user["warn-days"], 14);
    EXPECT_EQ(user["inactive-days"], nullptr);
    EXPECT_EQ(user["account-expires"], nullptr);
    EXPECT_EQ(user["login-failures-allowed"], 3);
    EXPECT_EQ(user["node"], "user:jdoe");
    EXPECT_EQ(user["no-node"], nullptr);
    EXPECT_FALSE(user.contains("unknown"));
}

TEST_F(AccountViews, SayWhyAnAccountHasNoNode)
{
    Outcome const outcome = mihostRun({"user", "nobody"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_TRUE(holds(outcome.out, "Node                  none: uid 65534 is above UID_MAX "
                                   "60000\n"));
    EXPECT_TRUE(holds(outcome.out, "Primary group         65534 (no group has this id)\n"));
    EXPECT_TRUE(holds(outcome.out, "Full name             \\x1b[2J\n"));
    EXPECT_EQ(outcome.err, "mihost: reading passwords and ageing: 'nobody' has no entry in "
                           "/etc/shadow, so some values are unknown (see 'mihost doctor')\n");
    Json const user = mihostJson({"user", "nobody"});
    EXPECT_EQ(user["node"], nullptr);
    EXPECT_EQ(user["no-node"], "uid 65534 is above UID_MAX 60000");
    EXPECT_EQ(user["state"], nullptr);
    EXPECT_EQ(user["unknown"], "'nobody' has no entry in /etc/shadow");
    EXPECT_TRUE(user["must-change-password"].is_null());
}

TEST_F(AccountViews, ShowOneGroupAsTextAndAsJson)
{
    Outcome const outcome = mihostRun({"group", "crew"});
    EXPECT_EQ(outcome.out, "Group             crew\n"
                           "GID               1001\n"
                           "Primary group of  -\n"
                           "Other members     jdoe, gone (no such local account)\n"
                           "Node              group:crew\n");
    EXPECT_EQ(outcome.code, 0);
    Json const group = mihostJson({"group", "jdoe"});
    EXPECT_EQ(group["primary-group-of"], Json::array({"jdoe"}));
    EXPECT_EQ(group["other-members"], Json::array());
}

TEST_F(AccountViews, ExitWith4ForAnUnknownName)
{
    EXPECT_EQ(mihostRun({"user", "jdeo"}),
              failed(4, "user: no account 'jdeo' (did you mean jdoe?)"));
    EXPECT_EQ(mihostRun({"group", "xyz"}),
              failed(4, "group: no group 'xyz' (see 'mihost list groups')"));
}

TEST_F(AccountViews, SayWhatOnlyRootCanRead)
{
    Outcome const outcome = machine::mihostRunAsUser({"user", "jdoe"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_TRUE(holds(outcome.out, "State                 -\n"));
    EXPECT_TRUE(holds(outcome.out, "Account expires       -\n"));
    EXPECT_TRUE(holds(outcome.err, "/etc/shadow cannot be read: Permission denied"));
}

} // namespace account_views_test
