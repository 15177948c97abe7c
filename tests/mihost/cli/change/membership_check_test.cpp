#include "mihost/cli/change/MembershipCheck.h"

#include "sysdata/osInfo_members.h"

#include <cctype>
#include <cstring>
#include <gtest/gtest.h>
#include <map>

namespace membership_check_test
{

using namespace mihost;

constexpr char plain[] = "uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),27(sudo),1500(crew)\n";

std::map<std::string, unsigned int> const database = {
    {"root", 0}, {"sudo", 27}, {"jdoe", 1000}, {"crew", 1500}, {"domain users", 1501},
};

std::optional<unsigned int> findGroup(std::string const& name)
{
    auto const found = database.find(name);
    return found == database.end() ? std::nullopt : std::optional(found->second);
}

std::string objectionTo(std::string const& text, std::string const& member = "jdoe")
{
    auto const identity = parseIdentity(text);
    return identity ? objectionToIdentity(*identity, member, findGroup).value_or("none")
                    : "not an identity";
}

TEST(Identity, IsReadWithIdsAndNames)
{
    auto const identity = parseIdentity(plain);
    ASSERT_TRUE(identity);
    EXPECT_EQ(identity->user, "jdoe");
    EXPECT_EQ(identity->primary.id, 1000U);
    ASSERT_EQ(identity->groups.size(), 3U);
    EXPECT_EQ(identity->groups[2].id, 1500U);
    EXPECT_EQ(identity->groups[2].name, "crew");
}

TEST(Identity, MayHaveGroupsWithoutAName)
{
    auto const identity = parseIdentity("id: cannot find name for group ID 1700\n"
                                        "uid=1000(jdoe) gid=1700 groups=1700,27(sudo)\n");
    ASSERT_TRUE(identity);
    EXPECT_EQ(identity->primary.name, "");
    EXPECT_EQ(identity->groups.at(1).name, "sudo");
}

TEST(Identity, IsNotReadFromAnyOtherForm)
{
    for (char const* text : {"", "id: 'jdoe': no such user\n", "uid=1000(jdoe) gid=1000(jdoe)\n",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe)",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe)\nmore\n",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),1500(x)(root)\n",
                             "uid=1000(jdoe) gid=1000(a(b) groups=1000(a(b)\n",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=1000()\n",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe\n",
                             "uid=1000(jdoe) gid=(jdoe) groups=1000(jdoe)\n",
                             "uid=1000(jdoe) gid=1000(jdoe) groups=99999999999(jdoe)\n",
                             "uid=1000(jdoe) gid=1000(jdoe) Gruppen=1000(jdoe)\n",
                             "id: cannot find name for group ID 1"})
        EXPECT_FALSE(parseIdentity(text)) << text;
}

TEST(MembershipChange, KeepsTheGroupsThatThePluginReads)
{
    auto const identity = parseIdentity(plain);
    std::string list = identity->primary.name + ",";
    for (Group const& group : identity->groups)
        list += '"' + group.name + "\",";
    EXPECT_EQ(NQ::os::supplementaryGroups(plain, "\"new\"", NQ::os::Membership::add),
              list + "\"new\"");
    EXPECT_EQ(objectionTo(plain), "none");
}

TEST(MembershipChange, IsRefusedForEachUnsafeByteInAGroupName)
{
    for (int byte = 1; byte < 256; ++byte) {
        std::string const name = std::string("a") + static_cast<char>(byte) + "b";
        auto const find = [](std::string const&) { return std::optional(1500U); };
        auto const isRefused = [&](Group const& primary, Group const& other) {
            return objectionToIdentity({"jdoe", primary, {primary, other}}, "jdoe", find)
                .has_value();
        };
        bool const isSafe =
            byte < 0x80 && (std::isalnum(byte) || std::strchr("@+-./_", byte) != nullptr);
        EXPECT_EQ(isRefused({1500, name}, {1500, "crew"}), !isSafe) << byte;
        // Within quotes a blank is harmless.
        EXPECT_EQ(isRefused({1500, "jdoe"}, {1500, name}), !isSafe && byte != ' ') << byte;
    }
}

TEST(MembershipChange, IsRefusedForGroupsThatUsermodWouldMistake)
{
    for (char const* name : {"0", "1500", "+0", "-1"}) {
        std::string const text = std::string("uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),"
                                             "1500(") +
                                 name + ")\n";
        EXPECT_EQ(objectionTo(text),
                  std::string("its group '") + name + "' has a name that usermod reads as a GID");
    }
    EXPECT_EQ(objectionTo("uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),1501(root)\n"),
              "its group 'root' has GID 1501, but usermod finds GID 0");
    EXPECT_EQ(objectionTo("uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),1600(x),0(root)\n"),
              "its group 'x' is not found by usermod");
    EXPECT_EQ(
        objectionTo("uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),1502(useradders)\n"),
        "its group 'useradders' contains 'useradd', so the plug-in would report the change as "
        "failed even if it succeeds");
    EXPECT_EQ(objectionTo(plain, "1000"), "id reads it as a UID, that of the account 'jdoe'");
    EXPECT_EQ(objectionTo("uid=1000(jdoe) gid=1000(jdoe) "
                          "groups=1000(jdoe),1500(x`touch${IFS}/root/PWNED`)\n"),
              "its group 'x`touch${IFS}/root/PWNED`' contains the shell metacharacter '`'");
    EXPECT_EQ(objectionTo("uid=1000(jdoe) gid=1000(jdoe) groups=1000(jdoe),1501(domain users),7\n"),
              "none");
}

} // namespace membership_check_test
