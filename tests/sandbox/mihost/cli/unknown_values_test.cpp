// Values that the plug-in cannot read are shown as unknown, not as zero.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

namespace unknown_values_test
{

class UnknownValues : public testing::Test
{
protected:
    UnknownValues()
    {
        machine::lay("plain");
        machine::writeIdRanges();
        machine::write("/etc/passwd", "root:x:0:0:root:/root:/bin/sh\n"
                                      "anna:x:1000:1000::/home/anna:/bin/sh\n"
                                      "ben:x:1001:1001::/home/ben:/bin/sh\n");
        writeShadow("root:*:19000:0:99999:7:::\nanna:!:19001:1:98:6:5:21919:\n"
                    "ben:!:19002:0:99999:7:::\n");
    }

    static void writeShadow(std::string const& text)
    {
        machine::write("/etc/shadow", text, 0600);
    }

    /** The names of the properties that are shown as unknown. */
    static Lines unknownOf(std::string const& user, std::string const& reason)
    {
        Lines names;
        Json const node = mihostJson({"get", user});
        for (auto const& [name, property] : node["properties"].items())
            if (property.contains("unknown")) {
                EXPECT_EQ(property["unknown"], reason);
                EXPECT_EQ(property["value"], nullptr);
                names.push_back(name);
            }
        return names;
    }

    Lines const all_ = {"password-expiry-days", "password-expiration", "password",
                        "inactive-time",        "password-length",     "last-password-change",
                        "password-min-days",    "password-warn-days",  "password-max-days"};
};

constexpr char warning[] = "mihost: reading passwords and ageing: /etc/shadow cannot be read: "
                           "Permission denied, so some values are unknown (see 'mihost doctor')\n";

TEST_F(UnknownValues, AreShownAsADashWithOneWarning)
{
    Outcome const outcome = machine::mihostRunAsUser(
        {"get", "user:anna", "password-max-days", "password", "last-password-change", "user-name"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.out, "163 password-max-days     -\n117 password              -\n"
                           "160 last-password-change  -\n108 user-name             anna\n");
    EXPECT_EQ(outcome.err, warning);
    for (Lines const& words :
         {Lines{"tree", "--all"}, Lines{"--json", "tree"},
          Lines{"list", "users", "--columns", "user-name,password-max-days"},
          Lines{"watch", "user:root", "inactive-time", "--count", "2", "--interval", "0"}})
        EXPECT_EQ(machine::mihostRunAsUser(words).err, warning) << words[0];
    for (Lines const& words : {Lines{"tree"}, Lines{"list", "users"},
                               Lines{"get", "user:anna", "user-name"}, Lines{"get", "os"}})
        EXPECT_EQ(machine::mihostRunAsUser(words).err, "") << words[0]; // none is shown
    EXPECT_EQ(
        machine::mihostRunAsUser({"shell"}, "get user:anna 163\nget os 108\nget user:anna 163\n")
            .err,
        std::string(warning) + warning); // once for each line
}

TEST_F(UnknownValues, AreNullInJsonWithTheReason)
{
    Outcome const outcome = machine::mihostRunAsUser({"--json", "get", "user:anna", "118", "117"});
    Json const properties = Json::parse(outcome.out)["properties"];
    for (Json const& property : properties) {
        EXPECT_EQ(property["value"], nullptr) << property;
        EXPECT_EQ(property["unknown"], "/etc/shadow cannot be read: Permission denied") << property;
        EXPECT_FALSE(property.contains("hidden")) << property;
    }
    EXPECT_EQ(properties.size(), 2U);
}

TEST_F(UnknownValues, BeginAtTheUserWithoutAShadowEntry)
{
    writeShadow("root:*:19000:0:99999:7:::\nben:!:19002:0:99999:7:::\n");
    EXPECT_EQ(unknownOf("user:root", ""), Lines());
    EXPECT_EQ(unknownOf("user:anna", "'anna' has no entry in /etc/shadow"), all_);
    EXPECT_EQ(unknownOf("user:ben",
                        "the entry of 'ben' in /etc/shadow is out of the order of /etc/passwd"),
              all_);
}

TEST_F(UnknownValues, AreNotZerosThatTheShadowFileHolds)
{
    writeShadow("root:*:0:0:0:0:0:0:\nanna:!:19001:0:0:0::21919:\nben:!:19002:0:99999:7:::\n");
    for (char const* user : {"user:root", "user:anna", "user:ben"}) {
        EXPECT_EQ(unknownOf(user, ""), Lines()) << user;
        EXPECT_EQ(mihostRun({"get", user}).err, "") << user;
    }
}

} // namespace unknown_values_test
