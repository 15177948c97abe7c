// Side effects of a write are announced, and the worst of them are prevented.

#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace write_warnings_test
{

using Json = nlohmann::ordered_json;

constexpr char expiryDay[] = "21919"; // 2030-01-05

class WriteWarnings : public testing::Test
{
protected:
    WriteWarnings()
    {
        machine::lay("plain");
        EXPECT_EQ(std::system("useradd -M -s /bin/sh -e 2030-01-05 jdoe"), 0);
    }

    static std::string expiry()
    {
        return machine::entry("/etc/shadow", "jdoe").at(7);
    }
};

TEST_F(WriteWarnings, UserSetAttribKeepsTheAccountsExpiry)
{
    ASSERT_EQ(expiry(), expiryDay);
    Outcome const outcome =
        mihostRun({"--json", "call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(expiry(), expiryDay);
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(3), "3");
    std::string const warning = "UserSetAttrib would erase the account's expiry 2030-01-05, so "
                                "mihost passes it (add --yes to erase it)";
    EXPECT_EQ(outcome.err, "mihost: " + warning + "\n");
    EXPECT_EQ(Json::parse(outcome.out)["warnings"], Json::array({warning}));
}

TEST_F(WriteWarnings, UserSetAttribErasesTheExpiryWithYes)
{
    Outcome const outcome =
        mihostRun({"--yes", "call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(expiry(), "");
    EXPECT_EQ(outcome.err, "mihost: UserSetAttrib erases the account's expiry 2030-01-05\n");
}

TEST_F(WriteWarnings, UserSetAttribSetsANewExpiryWithoutAWarning)
{
    Outcome const outcome =
        mihostRun({"call", "UserSetAttrib", "UserName=jdoe", "passwordExpirationDate=2030-01-06"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_EQ(expiry(), "21920");
}

TEST_F(WriteWarnings, AreNotGivenForAnAccountThatNeverExpires)
{
    ASSERT_EQ(std::system("chage -E -1 jdoe"), 0);
    Outcome const outcome =
        mihostRun({"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_EQ(expiry(), "");
}

TEST_F(WriteWarnings, UserSetAttribIsRefusedIfTheExpiryWouldBeLost)
{
    ASSERT_EQ(std::system("sed -i 's/:21919:/:99999999:/' /etc/shadow"), 0);
    machine::recordShell();
    Outcome const outcome =
        mihostRun({"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"});
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.err, "mihost: UserSetAttrib erases the account's expiry, and day '99999999' "
                           "cannot be kept (add --yes to erase it)\n");
    EXPECT_EQ(expiry(), "99999999");
}

TEST_F(WriteWarnings, DatesOfUserNodesSayWhatTheyReadAndWrite)
{
    ASSERT_EQ(std::system("chage -d 2020-01-01 -M 99999 jdoe"), 0);
    Outcome const expiration = mihostRun({"set", "user:jdoe", "password-expiration", "2020-01-31"});
    EXPECT_EQ(expiration.code, 0);
    EXPECT_EQ(
        expiration.err,
        "mihost: password-expiration reads the account's expiry date, but writing it sets the "
        "password's maximum age (for the date, use 'mihost user expire jdoe YYYY-MM-DD')\n");
    Outcome const inactivity = mihostRun({"set", "user:jdoe", "inactive-time", "2020-02-05"});
    EXPECT_EQ(inactivity.code, 0);
    EXPECT_EQ(
        inactivity.err.rfind("mihost: inactive-time reads the account's expiry date, but ", 0), 0U)
        << inactivity.err;
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
