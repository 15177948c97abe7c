// A copy of a machine whose root is not a mount point but any directory, as chroot(8) makes it.

#include "tests/sandbox/border/Caller.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <fstream>
#include <unistd.h>

namespace chroot_test
{

class Chroot : public BorderTest
{
protected:
    /** A machine with nothing in it but empty directories and one file. */
    void SetUp() override
    {
        BorderTest::SetUp();
        for (char const* name : {"proc", "sys", "dev", "run", "tmp", "sbin"})
            std::filesystem::create_directory(root_.path(name));
        root_.write("etc/file", "before");
    }

    void enter() const
    {
        if (chroot(root_.name().c_str()) != 0 || chdir("/etc") != 0)
            _exit(1);
    }

    ScratchFolder const root_;
};

TEST_F(Chroot, IsCopiedOnWrite)
{
    Caller caller(
        [] {
            Caller::sayWorkingDirectory();
            Caller::say(contentOf("file"));
            std::ofstream("/etc/file") << "after";
            std::ofstream("/tmp/new") << "new";
            Caller::say(contentOf("/etc/file") + contentOf("/tmp/new"));
            return exists("/proc/1/stat") && exists("/sbin/shutdown") ? 0 : 1;
        },
        "", [this] { enter(); });
    EXPECT_EQ(caller.hearAll(), "/etcbeforeafternew");
    EXPECT_EQ(caller.wait(), 0);
    EXPECT_EQ(contentOf(root_.path("etc/file")), "before");
    EXPECT_FALSE(exists(root_.path("tmp/new")));
    EXPECT_FALSE(exists(root_.path("sbin/shutdown")));
}

TEST_F(Chroot, IsCopiedWithItsMounts)
{
    std::filesystem::create_directory(root_.path("disk"));
    Caller caller(
        [] {
            Caller::say(contentOf("/disk/file"));
            std::ofstream("/disk/file") << "after";
            return contentOf("/disk/file") == "after" ? 0 : 1;
        },
        "",
        [this] {
            mountOwnDisk(root_.path("disk"));
            root_.write("disk/file", "before");
            enter();
            // From here on, the machine is what this process sees.
            continueInChild([] { Caller::say(" " + contentOf("/disk/file")); });
        });
    EXPECT_EQ(caller.hearAll(), "before before");
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Chroot, DoesNotChangeTheMountsOfTheMachine)
{
    std::string const before = contentOf("/proc/self/mountinfo");
    Caller caller([]() -> int { Caller::sayAndWait(); }, "", [this] { enter(); });
    ASSERT_EQ(caller.hear(1), ".");
    EXPECT_EQ(contentOf("/proc/self/mountinfo"), before);
}

TEST_F(Chroot, CannotBeLeftFromTheCopy)
{
    // Nothing of the file system around the directory is in the copy, whichever way is tried.
    Caller caller(
        [] {
            std::filesystem::create_directory("/tmp/deep");
            if (chroot("/tmp/deep") != 0)
                return 1;
            for (int level = 0; level < 100; ++level)
                if (chdir("..") != 0)
                    return 1;
            return exists("etc/file") && !exists("etc/passwd") ? 0 : 1;
        },
        "", [this] { enter(); });
    EXPECT_EQ(caller.wait(), 0);
}

} // namespace chroot_test
