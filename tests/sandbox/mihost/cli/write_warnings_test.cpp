// Side effects of a write are announced, and the worst of them are prevented.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

namespace write_warnings_test
{

constexpr char expiryDay[] = "21919"; // 2030-01-05

class WriteWarnings : public testing::Test
{
protected:
    WriteWarnings()
    {
        machine::lay("plain");
        machine::run("useradd -M -s /bin/sh -e 2030-01-05 jdoe");
    }

    static Outcome setMinimumAge(Lines arguments = {})
    {
        arguments.insert(arguments.end(),
                         {"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"});
        return mihostRun(arguments);
    }

    static std::string expiry()
    {
        return machine::entry("/etc/shadow", "jdoe").at(7);
    }
};

TEST_F(WriteWarnings, UserSetAttribKeepsTheExpiryUnlessItMayEraseIt)
{
    ASSERT_EQ(expiry(), expiryDay);
    Outcome const outcome = setMinimumAge({"--json"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(expiry(), expiryDay);
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(3), "3");
    std::string const warning = "UserSetAttrib would erase the account's expiry 2030-01-05, so "
                                "mihost passes it (add --yes to erase it)";
    EXPECT_EQ(outcome.err, "mihost: " + warning + "\n");
    EXPECT_EQ(Json::parse(outcome.out)["warnings"], Json::array({warning}));

    EXPECT_EQ(setMinimumAge({"--yes"}),
              failed(0, "UserSetAttrib erases the account's expiry 2030-01-05"));
    EXPECT_EQ(expiry(), "");
}

TEST_F(WriteWarnings, AreNotGivenForANewExpiryOrAnAccountWithoutOne)
{
    EXPECT_EQ(
        mihostRun({"call", "UserSetAttrib", "UserName=jdoe", "passwordExpirationDate=2030-01-06"}),
        printed(""));
    EXPECT_EQ(expiry(), "21920");
    machine::run("chage -E -1 jdoe");
    EXPECT_EQ(setMinimumAge(), printed(""));
    EXPECT_EQ(expiry(), "");
}

TEST_F(WriteWarnings, UserSetAttribIsRefusedIfTheExpiryWouldBeLost)
{
    machine::run("sed -i 's/:21919:/:99999999:/' /etc/shadow");
    EXPECT_EQ(setMinimumAge(),
              failed(2, "UserSetAttrib erases the account's expiry, and day '99999999' "
                        "cannot be kept (add --yes to erase it)"));
    EXPECT_EQ(expiry(), "99999999");
}

TEST_F(WriteWarnings, DatesOfUserNodesSayWhatTheyReadAndWrite)
{
    machine::run("chage -d 2020-01-01 -M 99999 jdoe");
    Outcome const expiration = mihostRun({"set", "user:jdoe", "password-expiration", "2020-01-31"});
    EXPECT_EQ(expiration.code, 0);
    EXPECT_EQ(
        expiration.err,
        "mihost: password-expiration reads the account's expiry date, but writing it sets the "
        "password's maximum age (for the date, use 'mihost user expire jdoe YYYY-MM-DD')\n");
    Outcome const inactivity = mihostRun({"set", "user:jdoe", "inactive-time", "2020-02-05"});
    EXPECT_EQ(inactivity.code, 0);
    EXPECT_TRUE(
        startsWith(inactivity.err, "mihost: inactive-time reads the account's expiry date, but "));
    EXPECT_EQ(expiry(), expiryDay);
}

TEST_F(WriteWarnings, PropertiesThatOnlyChangeTheTreeNameTheCommand)
{
    struct Row {
        char const* property;
        char const* value;
        char const* command;
    };
    std::string const before = machine::read("/etc/passwd") + machine::read("/etc/shadow");
    for (Row const& row :
         {Row{"login-shell", "/bin/zsh", "mihost user set-shell"},
          Row{"home-directory", "/home/j2", "mihost user set-home"},
          Row{"full-name", "J. Doe", "mihost user set-name"},
          Row{"password-max-days", "30", "mihost user age"},
          Row{"password-min-days", "3", "mihost user age"},
          Row{"password-warn-days", "5", "mihost user age"},
          Row{"password-expiry-days", "9", "mihost user age"},
          Row{"last-password-change", "2020-01-01", "chage -d"},
          Row{"user-name", "joe", "usermod -l"}, Row{"user-id", "1500", "usermod -u"},
          Row{"group-id", "1500", "usermod -g"}}) {
        Outcome const outcome = mihostRun({"--json", "set", "user:jdoe", row.property, row.value});
        EXPECT_EQ(outcome.code, 0) << row.property;
        std::string const warning =
            std::string(row.property) + " changed in memory only (use '" + row.command + "')";
        EXPECT_EQ(outcome.err, "mihost: " + warning + "\n");
        Json const answer = Json::parse(outcome.out);
        EXPECT_EQ(answer["changed"], false) << row.property;
        EXPECT_EQ(answer["warnings"], Json::array({warning}));
    }
    EXPECT_EQ(machine::read("/etc/passwd") + machine::read("/etc/shadow"), before);
    EXPECT_EQ(mihostRun({"set", "os", "refresh", "1"}).err,
              "mihost: refresh changed in memory only\n");
}

} // namespace write_warnings_test
