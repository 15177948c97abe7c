#include "mihost/sandbox/MountTable.h"
#include "tests/support/ScratchFolder.h"

#include <gtest/gtest.h>

namespace mount_table_test
{

using Paths = std::vector<std::string>;

Paths mountsIn(std::string const& text)
{
    ScratchFolder const folder;
    return mihost::mountsToCopy(folder.write("mountinfo", text));
}

TEST(MountTable, LeavesOutTheRootAndLinesThatEndEarly)
{
    EXPECT_EQ(mountsIn("1 0 8:1 / / rw,relatime - ext4 /dev/sda1 rw\n"), Paths());
    EXPECT_EQ(mountsIn("2 1 8:2 / /home rw shared:1\n\n2 1 8:2\n"), Paths());
}

TEST(MountTable, ListsOtherDisksParentsFirstAndEachOnce)
{
    EXPECT_EQ(mountsIn("4 1 8:4 / /var/log rw - ext4 /dev/sda4 rw\n"
                       "3 1 8:3 / /var rw shared:7 - xfs /dev/sda3 rw\n"
                       "2 1 8:2 / /home rw shared:1 master:2 - ext4 /dev/sda2 rw\n"
                       "5 3 0:9 / /var rw - tmpfs tmpfs rw\n"),
              (Paths{"/home", "/var", "/var/log"}));
}

TEST(MountTable, LeavesOutFileSystemsThatTheCopyHasItself)
{
    EXPECT_EQ(mountsIn("2 1 0:2 / /proc rw - proc proc rw\n"
                       "3 2 0:3 / /proc/sys/fs/binfmt_misc rw - tmpfs none rw\n"
                       "4 1 0:4 / /sys rw - sysfs sysfs rw\n"
                       "5 1 0:5 / /dev rw - devtmpfs udev rw\n"
                       "6 5 0:6 / /dev/shm rw - tmpfs tmpfs rw\n"
                       "7 1 0:7 / /run rw - tmpfs tmpfs rw\n"
                       "8 7 0:8 / /run/user/0 rw - tmpfs tmpfs rw\n"),
              Paths());
}

TEST(MountTable, LeavesOutTheKernelsOwnFileSystemsByWholeNames)
{
    EXPECT_EQ(mountsIn("2 1 0:2 / /misc rw - autofs /etc/auto.misc rw\n"
                       "3 1 0:3 / /srv/jail/proc rw - proc proc rw\n"),
              Paths());
    EXPECT_EQ(mountsIn("2 1 8:2 / /runtime rw - ext4 /dev/sda2 rw\n"), Paths{"/runtime"});
}

TEST(MountTable, ReadsOnlyCharactersThatAreEscaped)
{
    EXPECT_EQ(mountsIn("2 1 8:2 / /a\\040b\\011c\\012d\\134e rw - ext4 /dev/x rw\n"),
              Paths{"/a b\tc\nd\\e"});
    EXPECT_EQ(mountsIn("2 1 8:2 / /a\\9\\1 rw - ext4 /dev/x rw\n"), Paths{"/a\\9\\1"});
}

TEST(MountTable, IsNotTreatedAsEmptyIfItCannotBeRead)
{
    EXPECT_THROW(mihost::mountsToCopy("/nonexistent/mountinfo"), std::runtime_error);
}

} // namespace mount_table_test
