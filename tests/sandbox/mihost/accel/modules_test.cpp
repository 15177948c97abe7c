// lsmod and modinfo, asked in both ways and compared byte by byte.

#include "tests/support/BothWays.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <random>
#include <sys/mount.h>

namespace modules_test
{

using bothways::answered;
using bothways::real;
using kernelModules::Loaded;

using Facts = std::vector<std::string>;

TEST(AccelLsmod, ListsWhatIsLoadedAsLsmodDoes)
{
    kernelModules::load({{"ext4", 1011712, 1, {}},
                         {"mbcache", 16384, 1, {"ext4"}},
                         {"crc16", 16384, 3, {"ext4", "bluetooth", "l2tp_core"}},
                         {"a_module_with_a_very_long_name_indeed", 123456789012, 70000, {}},
                         {"going", 0, -1, {}}});
    std::string const text = real("lsmod");
    EXPECT_NE(text.find("mbcache                16384  1 ext4\n"), std::string::npos) << text;
    EXPECT_EQ(answered("lsmod"), text);
}

TEST(AccelLsmod, ListsHundredsOfModulesAsLsmodDoes)
{
    std::mt19937 random(3);
    std::vector<Loaded> modules;
    for (int i = 0; i < 400; ++i) {
        Loaded module{"m" + std::to_string(i) + std::string(random() % 30, '_'),
                      static_cast<long>(random() % 10000000),
                      static_cast<int>(random() % 2000),
                      {}};
        for (unsigned long holders = random() % 4; holders > 0 && !modules.empty(); --holders)
            module.holders.push_back(modules[random() % modules.size()].name);
        modules.push_back(module);
    }
    kernelModules::load(modules);
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelLsmod, ListsNothingButTheHeadWhenNothingIsLoaded)
{
    kernelModules::load({});
    EXPECT_EQ(answered("lsmod"), "Module                  Size  Used by\n");
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelLsmod, StepsAsideWhereLsmodWouldComplain)
{
    kernelModules::load({{"one", 1, 0, {}}});
    std::filesystem::remove("/sys/module/one/holders");
    EXPECT_NE(real("lsmod").find("ERROR"), std::string::npos);
    EXPECT_FALSE(answered("lsmod"));
    machine::remove("/proc/modules");
    EXPECT_FALSE(answered("lsmod"));
}

TEST(AccelLsmod, IsAsNegativeAsLsmodForModulesThatJustWent)
{
    kernelModules::load({{"one", 1, 0, {}}});
    machine::remove("/sys/module/one/refcnt");
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelLsmod, ListsTheModulesOfThisMachine)
{
    if (!std::filesystem::exists("/proc/modules"))
        GTEST_SKIP() << "the kernel has no loadable modules";
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelModinfo, TellsWhatModinfoTells)
{
    kernelModules::write(
        "kernel/one.ko",
        kernelModules::file({"version=1.2.3", "description=One and only", "author=A", "author=B",
                             "license=GPL", "alias=pci:v*d*", "depends=", "name=one"}));
    kernelModules::index();
    std::string const text = real("modinfo one");
    EXPECT_EQ(text, "filename:       " + kernelModules::folder() +
                        "/kernel/one.ko\n"
                        "version:        1.2.3\n"
                        "description:    One and only\n"
                        "author:         A\n"
                        "author:         B\n"
                        "license:        GPL\n"
                        "alias:          pci:v*d*\n"
                        "depends:        \n"
                        "name:           one\n");
    EXPECT_EQ(answered("modinfo one"), text);
}

TEST(AccelModinfo, PutsParametersTogetherAsModinfoDoes)
{
    kernelModules::write(
        "one.ko",
        kernelModules::file({"parm=a:first", "parmtype=a:int", "parmtype=b:bool",
                             "parm=b:second:with colon", "parm=text:only", "parmtype=type:only",
                             "parm=a:again", "parm=:", "parmtype=empty:", "parm=ab:", "x=y"}));
    kernelModules::index();
    EXPECT_EQ(answered("modinfo one"), real("modinfo one"));
}

std::string randomFact(std::mt19937& random)
{
    char const* const keys[] = {"version",    "description", "parm", "parmtype",
                                "author",     "depends",     "k",    "fifteen_letters",
                                "srcversion", "vermagic"};
    std::string fact = keys[random() % std::size(keys)];
    if (random() % 50 == 0)
        return fact;
    fact += fact.rfind("parm", 0) == 0 ? "=p" + std::to_string(random() % 6) + ':' : "=";
    for (unsigned long length = random() % 40; length > 0; --length)
        fact += static_cast<char>(1 + random() % 255);
    if (random() % 20 == 0)
        fact += std::string(random() % 3000, 'x');
    return fact;
}

std::string randomModule(std::mt19937& random)
{
    Facts facts;
    for (unsigned long count = random() % 25; count > 0; --count)
        facts.push_back(randomFact(random));
    std::string content = kernelModules::file(facts);
    switch (random() % 10) {
    case 0:
        return content + kernelModules::signature("somebody\xff");
    case 1:
        return content.substr(0, random() % content.size());
    case 2:
        content[random() % content.size()] ^= static_cast<char>(1U << random() % 8);
        return content;
    default:
        return content;
    }
}

/** An answer is modinfo's, and none is given where modinfo complains. @return whether one lacks */
bool isLeftOut(std::string const& name)
{
    std::string const text = real("modinfo " + name);
    std::optional<std::string> const own = answered("modinfo " + name);
    bool const complained = text.find("ERROR") != std::string::npos;
    EXPECT_FALSE(own && complained) << name << ": " << text;
    if (own) {
        EXPECT_EQ(*own, text) << name;
    }
    return !own && !complained;
}

/** Both ways agree, and the accelerator steps aside exactly where modinfo complains. */
void expectAgreement(std::string const& name)
{
    EXPECT_FALSE(isLeftOut(name)) << name;
}

TEST(AccelModinfo, AgreesWithModinfoOnThousandsOfModules)
{
    std::mt19937 random(11);
    constexpr int modules = 1000;
    for (int i = 0; i < modules; ++i)
        kernelModules::write("kernel/drivers/mod-" + std::to_string(i) + ".ko",
                             randomModule(random));
    kernelModules::index();
    int leftOut = 0; // a changed byte may have made a key too long
    for (int i = 0; i < modules; ++i)
        for (char const* name : {"mod_", "mod-"})
            leftOut += isLeftOut(name + std::to_string(i));
    EXPECT_LT(leftOut, modules / 50);
}

TEST(AccelModinfo, IsLeftToModinfoWhenNotAllOfThemPrintAlike)
{
    kernelModules::write("one.ko", kernelModules::file({"version=1", "sixteen_letters_=x"}));
    kernelModules::write("two.ko", kernelModules::file({"version=1", "fifteen_letters=x"}));
    kernelModules::write("a.ko", kernelModules::file({"alias=of-both"}));
    kernelModules::write("b.ko", kernelModules::file({"alias=of-both"}));
    kernelModules::write("modules.builtin", "kernel/built_in.ko\n");
    kernelModules::index();
    EXPECT_FALSE(answered("modinfo one"));
    EXPECT_FALSE(answered("modinfo of-both"));
    EXPECT_FALSE(answered("modinfo built_in"));
    expectAgreement("two");
}

/** The name of a module from its file's: without what follows the first dot. */
std::string moduleOf(std::filesystem::path const& file)
{
    std::string const name = file.filename();
    return name.substr(0, name.find('.'));
}

TEST(AccelModinfo, AgreesWithModinfoOnInstalledKernels)
{
    std::filesystem::create_directories(kernelModules::folder());
    std::size_t compared = 0;
    for (auto const& kernel : std::filesystem::directory_iterator("/lib/modules")) {
        std::string const own = kernelModules::folder();
        ASSERT_EQ(mount(kernel.path().c_str(), own.c_str(), nullptr, MS_BIND, nullptr), 0);
        for (auto const& file : std::filesystem::recursive_directory_iterator(own))
            if (file.path().filename().string().find(".ko") != std::string::npos &&
                compared++ % 10 == 0)
                expectAgreement(moduleOf(file));
        umount2(own.c_str(), MNT_DETACH);
    }
    if (compared == 0)
        GTEST_SKIP() << "no kernel with modules is installed";
}

TEST(AccelModinfo, AgreesWithModinfoOnAmbiguousNames)
{
    kernelModules::write("a.ko",
                         kernelModules::file({"alias=net-pf-1", "alias=other_name", "name=a"}));
    kernelModules::write("b.ko", kernelModules::file({"alias=net-pf-*", "alias=other_name"}));
    kernelModules::write("extra/c.ko", kernelModules::file({"description=extra"}));
    kernelModules::write("kernel/c.ko", kernelModules::file({"description=kernel"}));
    kernelModules::write("modules.builtin", "kernel/built_in.ko\nkernel/known.ko\n");
    kernelModules::write("modules.builtin.modinfo",
                         std::string("known.version=7\0known.alias=net-pf-9\0"
                                     "known.parm=x:text\0known.parmtype=x:int\0",
                                     75));
    kernelModules::index();
    // Several modules, or built in ones, are left to modinfo.
    for (char const* name :
         {"net-pf-1", "net_pf_1", "net-pf-9", "other_name", "other-name", "built_in", "known"})
        isLeftOut(name);
    for (char const* name : {"a", "b", "c", "net-pf-2", "nothing", "A", "ab"})
        expectAgreement(name);
}

TEST(AccelModinfo, ReadsCompressedModules)
{
    kernelModules::write("one.ko", kernelModules::file({"version=1", "description=compressed"}));
    ASSERT_EQ(std::system(("xz " + kernelModules::folder() + "/one.ko").c_str()), 0);
    kernelModules::index();
    EXPECT_NE(real("modinfo one").find("one.ko.xz"), std::string::npos);
    expectAgreement("one");
}

TEST(AccelModinfo, SeesWhatChangedSinceTheLastTime)
{
    for (char const* version : {"version=1", "version=2"}) {
        kernelModules::write("one.ko", kernelModules::file({version}));
        kernelModules::index();
        expectAgreement("one");
    }
    machine::remove(kernelModules::folder() + "/one.ko");
    expectAgreement("one");
    kernelModules::index();
    expectAgreement("one");
}

} // namespace modules_test
