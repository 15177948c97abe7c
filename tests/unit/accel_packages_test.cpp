#include "mihost/accel/Modules.h"
#include "mihost/accel/Packages.h"
#include "mihost/accel/Tool.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace
{

using miaccel::digestIn;

std::string versionIn(std::string const& status, std::string const& package)
{
    return miaccel::fieldIn(status, package, "Version");
}

std::string const status = "Package: sed-doc\n"
                           "Status: install ok installed\n"
                           "Version: 1\n"
                           "\n"
                           "Package: sed\n"
                           "Status: install ok installed\n"
                           "Section: utils\n"
                           "Version: 4.9-1\n"
                           "Description: stream editor\n"
                           " Version: 9\n"
                           "\n"
                           "Package: kmod\n"
                           "Status: deinstall ok config-files\n"
                           "Version: 30-1\n"
                           "\n"
                           "Package: wc\n"
                           "Status: install ok installed\n"
                           "\n"
                           "Package: last\n"
                           "Status: install ok installed\n"
                           "Version: 2:3\n";

TEST(PackageVersion, IsThatOfTheInstalledPackage)
{
    EXPECT_EQ(versionIn(status, "sed"), "4.9-1");
    EXPECT_EQ(versionIn(status, "sed-doc"), "1");
    EXPECT_EQ(versionIn(status, "last"), "2:3");
}

TEST(PackageField, IsThatOfItsName)
{
    EXPECT_EQ(miaccel::fieldIn(status, "sed", "Section"), "utils");
    EXPECT_EQ(miaccel::fieldIn(status, "sed", "Architecture"), "");
}

TEST(PackageVersion, IsEmptyForWhatIsNotInstalled)
{
    EXPECT_EQ(versionIn(status, "kmod"), "");
    EXPECT_EQ(versionIn(status, "dash"), "");
    EXPECT_EQ(versionIn(status, "wc"), "");
    EXPECT_EQ(versionIn("", "sed"), "");
}

TEST(PackageVersion, IsThatOfTheInstalledArchitecture)
{
    EXPECT_EQ(versionIn("Package: a\nStatus: deinstall ok config-files\nVersion: 1\n\n"
                        "Package: a\nStatus: install ok installed\nVersion: 2\n",
                        "a"),
              "2");
}

std::string const list = "eabbb6891e630b56133f5586c2967d24  bin/date\n"
                         "1ba73ec5f15bb880732fe6e78456fc3e  usr/bin/wc\n"
                         "00000000000000000000000000000000  opt/bin/date\n";

TEST(PackageDigest, IsThatOfThePath)
{
    EXPECT_EQ(digestIn(list, "/usr/bin/wc"), "1ba73ec5f15bb880732fe6e78456fc3e");
    EXPECT_EQ(digestIn(list, "/opt/bin/date"), "00000000000000000000000000000000");
}

TEST(PackageDigest, IsFoundUnderTheNameFromBeforeUsrWasMerged)
{
    EXPECT_EQ(digestIn(list, "/usr/bin/date"), "eabbb6891e630b56133f5586c2967d24");
}

TEST(PackageDigest, IsEmptyForOtherPaths)
{
    EXPECT_EQ(digestIn(list, "/usr/bin/w"), "");
    EXPECT_EQ(digestIn(list, "/bin/wc"), "");
    EXPECT_EQ(digestIn(list, "/date"), "");
    EXPECT_EQ(digestIn("x  usr/bin/wc\n", "/usr/bin/wc"), "");
    EXPECT_EQ(digestIn("", "/usr/bin/wc"), "");
}

TEST(PackagedFile, IsToldFromOthers)
{
    EXPECT_TRUE(miaccel::isFromPackage("/usr/bin/wc", "coreutils", ""));
    EXPECT_TRUE(miaccel::isFromPackage("/usr/bin/wc", "coreutils", "8.32- 9."));
    EXPECT_TRUE(miaccel::isFromPackage("/usr/bin/wc", "coreutils", "9. 8.32-"));
    EXPECT_FALSE(miaccel::isFromPackage("/usr/bin/wc", "coreutils", "8.32- 8.30-"));
    EXPECT_FALSE(miaccel::isFromPackage("/usr/bin/wc", "sed", ""));
    EXPECT_FALSE(miaccel::isFromPackage("/usr/bin/nonexistent", "coreutils", ""));
    EXPECT_FALSE(miaccel::isFromPackage("/usr/bin/wc", "nonexistent", ""));
}

TEST(PackagedFile, MayComeFromAPackageWhoseListNamesItsArchitecture)
{
    EXPECT_EQ(miaccel::strangeLibrary(), nullptr);
}

TEST(Tool, IsReachedByEveryPathToItsFile)
{
    miaccel::Tool const kmod{"/usr/bin/kmod", "kmod", ""};
    EXPECT_TRUE(miaccel::leadsTo("/usr/bin/kmod", kmod));
    EXPECT_TRUE(miaccel::leadsTo("/sbin/lsmod", kmod));
    EXPECT_FALSE(miaccel::leadsTo("/usr/bin/wc", kmod));
    EXPECT_FALSE(miaccel::leadsTo("", kmod));
}

TEST(Tool, IsNotGenuineOnceItsFileIsAnotherOne)
{
    ScratchFolder const folder;
    std::string const path = folder.write("tool", "text");
    EXPECT_FALSE(miaccel::isGenuine({path.c_str(), "coreutils", ""}));
    EXPECT_FALSE(miaccel::isGenuine({"/usr/bin", "coreutils", ""}));
}

} // namespace
