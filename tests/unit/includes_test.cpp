// Who includes whom among the plug-in's folders.

#include "TestPaths.h"
#include "tests/support/Lines.h"

#include <algorithm>
#include <filesystem>
#include <gtest/gtest.h>
#include <map>
#include <regex>

namespace
{

namespace fs = std::filesystem;
using Names = std::vector<std::string>;

/** What the files of a folder may include: other folders, or single files of them. */
std::map<std::string, Names> const mayInclude = {
    {"host", {}},
    {"util", {"host"}},
    {"sysdata", {"util", "host"}},
    {"nodes", {"frame/OsSwMI.h", "sysdata", "util", "host"}},
    {"frame", {"nodes", "util", "host"}},
};

Names includesIn(fs::path const& file)
{
    static std::regex const include("#include \"([^\"]+)\"");
    Names found;
    for (std::string const& line : linesOf(contentOf(file.string())))
        if (std::smatch match; std::regex_match(line, match, include))
            found.push_back(match[1]);
    return found;
}

bool isAllowed(std::string const& folder, fs::path const& included)
{
    std::string const of = included.parent_path().string();
    Names const& others = mayInclude.at(folder);
    return of == folder || std::any_of(others.begin(), others.end(), [&](std::string const& other) {
               return other == of || other == included.string();
           });
}

TEST(Includes, PointOneWay)
{
    for (auto const& [folder, others] : mayInclude) {
        std::size_t seen = 0;
        for (fs::directory_entry const& entry : fs::directory_iterator(TESTS_DIR "/../" + folder))
            for (std::string const& included : includesIn(entry.path())) {
                ++seen;
                EXPECT_TRUE(isAllowed(folder, included))
                    << entry.path() << " includes " << included;
            }
        EXPECT_GT(seen, 0U) << folder;
    }
}

} // namespace
