#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/Plugin.h"

#include <algorithm>

namespace offered_words_test
{

using Words = std::vector<std::string>;

Words offered(std::string const& word)
{
    Words words = linesOf(mihostRun({"__complete", "get", word}).out);
    EXPECT_EQ(words.at(0), "words");
    words.erase(words.begin());
    return words;
}

Words shown(Plugin& plugin, unsigned int type, std::string const& before)
{
    Words words;
    for (IC::MutableNode* const node : plugin.nodes(type))
        words.push_back(before + text(*node, IC::property::name));
    return words;
}

class CompletionOn : public testing::TestWithParam<char const*>
{
};

TEST_P(CompletionOn, OffersTheUsersAndGroupsOfTheTree)
{
    machine::lay(GetParam());
    Plugin plugin;
    plugin.initialize();
    EXPECT_EQ(offered("user:"), shown(plugin, IC::nodeType::user, "user:"));
    EXPECT_EQ(offered("group:"), shown(plugin, IC::nodeType::group, "group:"));
}

INSTANTIATE_TEST_SUITE_P(Machines, CompletionOn,
                         testing::Values("redhat", "suse", "users-range-ends", "users-two-roots",
                                         "users-without-login-defs", "users-without-passwd",
                                         "groups-without-login-defs"),
                         [](auto const& which) {
                             std::string name = which.param;
                             std::replace(name.begin(), name.end(), '-', '_');
                             return name;
                         });

TEST(Completion, OffersTheModulesOfTheTree)
{
    Plugin plugin;
    plugin.initialize();
    EXPECT_EQ(offered("driver:"), shown(plugin, IC::nodeType::driver, "driver:"));
}

} // namespace offered_words_test
