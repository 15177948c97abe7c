// The version of the top CMakeLists.txt is also in files that are not configured. They agree with
// the program.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>
#include <regex>

namespace version_test
{

/** The output of --version, without the name of the program. */
std::string programVersion()
{
    std::string const out = mihostRun({"--version"}).out;
    std::smatch found;
    return std::regex_match(out, found, std::regex("mihost (.*)\n")) ? found[1].str() : out;
}

/** As Debian and RPM packages write it: what follows a tilde sorts before nothing. */
std::string packageVersion()
{
    return std::regex_replace(programVersion(), std::regex("-"), "~");
}

/** What the pattern's group matches in the first line of the file that it matches. */
std::string versionIn(char const* file, char const* pattern)
{
    std::smatch found;
    std::regex const wanted(pattern);
    for (std::string const& line : linesOf(contentOf(std::string(DOCS_DIR "/../") + file)))
        if (std::regex_match(line, found, wanted))
            return found[1];
    return std::string("none in ") + file;
}

TEST(Version, HasThreeNumbersAndMaybeASuffix)
{
    EXPECT_TRUE(std::regex_match(programVersion(), std::regex("\\d+\\.\\d+\\.\\d+(-rc\\d+)?")))
        << programVersion();
}

TEST(Version, IsInEveryFileThatIsNotConfigured)
{
    EXPECT_EQ(versionIn("CHANGELOG.md", "## (\\d.*) - \\d{4}-\\d\\d-\\d\\d"), programVersion());
    EXPECT_EQ(versionIn("integrations/ansible/galaxy.yml", "version: (.*)"), programVersion());
    EXPECT_EQ(versionIn("integrations/cockpit/manifest.json", " *\"version\": \"(.*)\","),
              programVersion());
    EXPECT_EQ(versionIn("packaging/debian/changelog", "mihost \\((.*)-\\d+\\).*"),
              packageVersion());
}

TEST(Version, IsThatOfTheRpmPackages)
{
    for (char const* family : {"tests/package/expected/fedora", "tests/package/expected/opensuse"})
        EXPECT_EQ(versionIn(family, "package mihost (.*)-\\d+"), packageVersion()) << family;
    std::string const built = contentOf(BUILD_DIR "/CPackConfig.cmake");
    std::string const wanted = "set(CPACK_PACKAGE_VERSION \"" + packageVersion() + "\")";
    EXPECT_NE(built.find(wanted), std::string::npos) << wanted;
}

} // namespace version_test
