// The sandbox in a chroot: a root that is not a mount point, without /proc and /dev.

#include "TestPaths.h"
#include "tests/contract/mihost/cli/NeedsSandbox.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <nlohmann/json.hpp>
#include <sstream>

namespace in_a_chroot_test
{

namespace fs = std::filesystem;
using Json = nlohmann::ordered_json;

/** The program, the plug-in, a shell, and what they are linked to. */
class SmallMachine
{
public:
    SmallMachine()
    {
        for (char const* directory : {"proc", "sys", "dev", "run", "tmp", "sbin"})
            fs::create_directory(root_.path(directory));
        for (std::string const program : {MIHOST_FILE, PLUGIN_FILE, "/bin/sh"}) {
            add(program);
            std::istringstream words(runToEnd({"/usr/bin/ldd", program}).out);
            for (std::string word; words >> word;)
                if (word.front() == '/')
                    add(word);
        }
        for (auto const& library : fs::directory_iterator(fs::path(PLUGIN_FILE).parent_path()))
            if (library.is_regular_file() || library.is_symlink())
                add(library.path());
        root_.write("etc/passwd", "root:x:0:0::/:/bin/sh\n");
        root_.write("etc/group", "root:x:0:\n");
        fs::permissions(root_.write("usr/sbin/groupadd", "#!/bin/sh\necho g:x:1: >>/etc/group\n"),
                        fs::perms::owner_all);
    }

    Outcome mihost(std::vector<std::string> const& arguments) const
    {
        std::vector<std::string> all = {"/usr/sbin/chroot", root_.name(), MIHOST_FILE};
        all.insert(all.end(), arguments.begin(), arguments.end());
        return runToEnd(all);
    }

    std::string content(std::string const& file) const
    {
        return contentOf(root_.path(file));
    }

private:
    void add(fs::path const& file) const
    {
        fs::path const place = root_.name() / file.relative_path();
        fs::create_directories(place.parent_path());
        if (!fs::exists(place))
            fs::copy_file(file, place);
    }

    ScratchFolder const root_;
};

using MihostInAChroot = NeedsSandbox;

TEST_F(MihostInAChroot, TriesAChangeInASandbox)
{
    SmallMachine const machine;
    Outcome const outcome = machine.mihost(
        {"--json", "--plugin", PLUGIN_FILE, "--sandbox", "call", "LocalGroupAdd", "GroupName=g"});
    ASSERT_NE(outcome.out, "") << outcome.err;
    Json const changes = Json::parse(outcome.out)["changes"];
    ASSERT_EQ(changes.size(), 1U) << changes;
    EXPECT_EQ(changes[0]["file"], "/etc/group");
    EXPECT_EQ(changes[0]["added"], Json({"g:x:1:"}));
    EXPECT_EQ(machine.content("etc/group"), "root:x:0:\n");
}

} // namespace in_a_chroot_test
