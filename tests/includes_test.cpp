// Which directory includes which.

#include "TestPaths.h"
#include "tests/support/Lines.h"

#include <algorithm>
#include <filesystem>
#include <gtest/gtest.h>
#include <map>
#include <regex>
#include <sstream>

namespace includes_test
{

namespace fs = std::filesystem;
using Names = std::vector<std::string>;

/** What the files of a directory may include: other directories, or single files of them. */
using Rules = std::map<std::string, Names>;

Rules const ownRules = {
    {"host", {}},
    {"util", {"host"}},
    {"sysdata", {"util", "host"}},
    {"nodes", {"frame/OsSwMI.h", "sysdata", "util", "host"}},
    {"frame", {"nodes", "util", "host"}},
    {"mihost/runtime", {"host"}},
    {"mihost/hostcheck", {"host"}},
    {"mihost/sandbox", {}},
    {"mihost/accel", {"mihost/sandbox/Descriptor.h"}},
    {"integrations/prometheus/exporter", {"mihost/sandbox/Descriptor.h"}},
};

/** What every directory of the program may include besides those that it uses. */
Names const belowTheProgram = {"host", "mihost/runtime", "mihost/sandbox", "mihost/accel/Accel.h"};

void add(Names& names, Names const& more)
{
    names.insert(names.end(), more.begin(), more.end());
}

/** From lines such as "mi_add_cli_part(doctor USES change log LIBRARIES ...)", in which the
 * directories that others use come first. */
Rules rulesOfTheProgram()
{
    static std::regex const part("mi_add_cli_part\\((\\w+)(?: USES((?: [a-z]+)+))?.*");
    Rules rules;
    for (std::string const& line : linesOf(contentOf(TESTS_DIR "/../mihost/cli/CMakeLists.txt"))) {
        std::smatch match;
        if (!std::regex_match(line, match, part))
            continue;
        Names& own = rules["mihost/cli/" + match[1].str()] = belowTheProgram;
        std::istringstream used(match[2].str());
        for (std::string name; used >> name;) {
            own.push_back("mihost/cli/" + name);
            add(own, rules.at("mihost/cli/" + name));
        }
    }
    return rules;
}

Names includesIn(fs::path const& file)
{
    static std::regex const include("#include \"([^\"]+)\"");
    Names found;
    for (std::string const& line : linesOf(contentOf(file.string())))
        if (std::smatch match; std::regex_match(line, match, include))
            found.push_back(match[1]);
    return found;
}

bool isAllowed(fs::path const& included, std::string const& folder, Names const& others)
{
    std::string const of = included.parent_path().string();
    return of == folder || std::any_of(others.begin(), others.end(), [&](std::string const& other) {
               return other == of || other == included.string();
           });
}

void expectAllowedOnly(std::string const& folder, Names const& others)
{
    std::size_t seen = 0;
    for (fs::directory_entry const& entry : fs::directory_iterator(TESTS_DIR "/../" + folder))
        for (std::string const& included : includesIn(entry.path())) {
            ++seen;
            EXPECT_TRUE(isAllowed(included, folder, others))
                << entry.path() << " includes " << included;
        }
    EXPECT_GT(seen, 0U) << folder;
}

TEST(Includes, PointOneWay)
{
    for (auto const& [folder, others] : ownRules)
        expectAllowedOnly(folder, others);
}

TEST(Includes, OfTheProgramPointOneWay)
{
    Rules const rules = rulesOfTheProgram();
    EXPECT_GT(rules.size(), 10U);
    for (auto const& [folder, others] : rules)
        expectAllowedOnly(folder, others);
}

} // namespace includes_test
