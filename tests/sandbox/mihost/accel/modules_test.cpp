// lsmod and modinfo, run and answered by the accelerator, and compared byte by byte.

#include "tests/support/BothWays.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <filesystem>
#include <random>
#include <sys/mount.h>

namespace modules_test
{

using bothways::answered;
using bothways::real;
using kernelModules::Loaded;

namespace fs = std::filesystem;

TEST(AccelLsmod, ListsWhatIsLoadedAsLsmodDoes)
{
    kernelModules::load({{"ext4", 1011712, 1, {}},
                         {"mbcache", 16384, 1, {"ext4"}},
                         {"crc16", 16384, 3, {"ext4", "bluetooth", "l2tp_core"}},
                         {"a_module_with_a_very_long_name_indeed", 123456789012, 70000, {}},
                         {"going", 0, -1, {}},
                         {"gone", 1, 0, {}}});
    machine::remove("/sys/module/gone/refcnt");
    std::string const text = real("lsmod");
    EXPECT_TRUE(holds(text, "mbcache                16384  1 ext4\n"));
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

TEST(AccelLsmod, ListsOnlyTheHeaderIfNothingIsLoaded)
{
    kernelModules::load({});
    EXPECT_EQ(answered("lsmod"), "Module                  Size  Used by\n");
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelLsmod, GivesNoAnswerIfLsmodPrintsErrors)
{
    kernelModules::load({{"one", 1, 0, {}}});
    fs::remove("/sys/module/one/holders");
    EXPECT_TRUE(holds(real("lsmod"), "ERROR"));
    EXPECT_FALSE(answered("lsmod"));
    machine::remove("/proc/modules");
    EXPECT_FALSE(answered("lsmod"));
}

TEST(AccelLsmod, ListsTheModulesOfThisMachine)
{
    if (!fs::exists("/proc/modules"))
        GTEST_SKIP() << "the kernel has no loadable modules";
    EXPECT_EQ(answered("lsmod"), real("lsmod"));
}

TEST(AccelModinfo, AnswersAsModinfoDoes)
{
    kernelModules::install({{"kernel/one.ko",
                             {"version=1.2.3", "description=One and only", "author=A", "author=B",
                              "license=GPL", "alias=pci:v*d*", "depends=", "name=one"}},
                            {"two.ko",
                             {"parm=a:first", "parmtype=a:int", "parmtype=b:bool",
                              "parm=b:second:with colon", "parm=text:only", "parmtype=type:only",
                              "parm=a:again", "parm=:", "parmtype=empty:", "parm=ab:", "x=y"}}});
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
    EXPECT_EQ(answered("modinfo two"), real("modinfo two"));
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
    std::vector<std::string> facts(random() % 25);
    for (std::string& fact : facts)
        fact = randomFact(random);
    std::string content = kernelModules::file(facts);
    unsigned long const damage = random() % 10;
    if (damage == 0)
        content += kernelModules::signature("somebody\xff");
    else if (damage == 1)
        content.resize(random() % content.size());
    else if (damage == 2)
        content[random() % content.size()] ^= static_cast<char>(1U << random() % 8);
    return content;
}

/**
 * Expects that an answer is what modinfo prints, and that there is none if modinfo prints an error.
 *
 * @return whether it does not answer although modinfo prints no error
 */
bool isLeftOut(std::string const& name)
{
    std::string const text = real("modinfo " + name);
    std::optional<std::string> const own = answered("modinfo " + name);
    bool const complained = text.find("ERROR") != std::string::npos;
    EXPECT_FALSE(own && complained) << name << ": " << text;
    EXPECT_EQ(own.value_or(text), text) << name;
    return !own && !complained;
}

/** Expects the output of modinfo, and an answer unless modinfo prints an error. */
void expectAgreement(std::string const& name)
{
    EXPECT_FALSE(isLeftOut(name)) << name;
}

TEST(AccelModinfo, AgreesWithModinfoOnRandomModules)
{
    std::mt19937 random(11);
    constexpr int modules = 150;
    for (int i = 0; i < modules; ++i)
        kernelModules::write("kernel/drivers/mod-" + std::to_string(i) + ".ko",
                             randomModule(random));
    kernelModules::index();
    int leftOut = 0; // a changed byte may have made a key too long
    for (int i = 0; i < modules; ++i)
        leftOut += isLeftOut((i % 10 == 0 ? "mod-" : "mod_") + std::to_string(i));
    EXPECT_LT(leftOut, modules / 50);
}

TEST(AccelModinfo, AgreesWithModinfoOnInstalledKernels)
{
    std::string const own = kernelModules::folder();
    fs::create_directories(own);
    std::size_t compared = 0;
    for (auto const& kernel : fs::directory_iterator("/lib/modules")) {
        ASSERT_EQ(mount(kernel.path().c_str(), own.c_str(), nullptr, MS_BIND, nullptr), 0);
        for (auto const& file : fs::recursive_directory_iterator(own)) {
            std::string const name = file.path().filename();
            if (name.find(".ko") != std::string::npos && compared++ % 10 == 0)
                expectAgreement(name.substr(0, name.find('.')));
        }
        umount2(own.c_str(), MNT_DETACH);
    }
    if (compared == 0)
        GTEST_SKIP() << "no kernel with modules is installed";
}

TEST(AccelModinfo, AgreesWithModinfoOnAmbiguousNames)
{
    kernelModules::write("modules.builtin", "kernel/built_in.ko\nkernel/known.ko\n");
    kernelModules::write("modules.builtin.modinfo",
                         std::string("known.version=7\0known.alias=net-pf-9\0"
                                     "known.parm=x:text\0known.parmtype=x:int\0",
                                     75));
    kernelModules::install({{"a.ko", {"alias=net-pf-1", "alias=other_name", "name=a"}},
                            {"b.ko", {"alias=net-pf-*", "alias=other_name"}},
                            {"extra/c.ko", {"description=extra"}},
                            {"kernel/c.ko", {"description=kernel"}},
                            {"long.ko", {"version=1", "sixteen_letters_=x"}},
                            {"short.ko", {"version=1", "fifteen_letters=x"}}});
    // Versions of modinfo print these differently: long keys, several modules, built-in ones.
    for (char const* name : {"long", "other_name", "other-name", "built_in"}) {
        isLeftOut(name);
        EXPECT_FALSE(answered(std::string("modinfo ") + name)) << name;
    }
    for (char const* name : {"net-pf-1", "net_pf_1", "net-pf-9", "known"})
        isLeftOut(name);
    for (char const* name : {"a", "b", "c", "short", "net-pf-2", "nothing", "A", "ab"})
        expectAgreement(name);
}

TEST(AccelModinfo, NoticesChangesSinceTheLastAnswer)
{
    for (char const* version : {"version=1", "version=2"}) {
        kernelModules::install({{"one.ko", {version}}});
        expectAgreement("one");
    }
    std::string const file = kernelModules::folder() + "/one.ko";
    machine::run("xz " + file + " && depmod");
    EXPECT_TRUE(holds(real("modinfo one"), "one.ko.xz"));
    expectAgreement("one");
    machine::remove(file + ".xz");
    expectAgreement("one");
    kernelModules::index();
    expectAgreement("one");
}

} // namespace modules_test
