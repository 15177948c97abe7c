#include "mihost/cli/change/AccountChanges.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

namespace account_changes_test
{

using mihost::AccountFiles;
using mihost::changesBetween;
using mihost::Secrets;

TEST(AccountFileChanges, AreTheRemovedAndTheAddedLines)
{
    AccountFiles const before = {{"/etc/passwd", {"root:x:0:0::/root:/bin/sh", "a:x:1:1::/:/x"}},
                                 {"/etc/group", {"root:x:0:"}}};
    AccountFiles const after = {{"/etc/passwd", {"root:x:0:0::/root:/bin/sh", "b:x:2:2::/:/x"}},
                                {"/etc/group", {"root:x:0:"}}};
    auto const changes = changesBetween(before, after, Secrets::Hide);
    ASSERT_EQ(changes.size(), 1U);
    EXPECT_EQ(changes[0].file, "/etc/passwd");
    EXPECT_EQ(changes[0].removed, Lines{"a:x:1:1::/:/x"});
    EXPECT_EQ(changes[0].added, Lines{"b:x:2:2::/:/x"});
}

TEST(AccountFileChanges, HideHashesUnlessAskedForThem)
{
    AccountFiles const before = {{"/etc/shadow", {"jdoe:!:19000::::::"}}};
    AccountFiles const after = {{"/etc/shadow", {"jdoe:$6$salt$hash:19000::::::"}}};
    auto const hidden = changesBetween(before, after, Secrets::Hide);
    EXPECT_EQ(hidden.at(0).removed, Lines{"jdoe:!:19000::::::"});
    EXPECT_EQ(hidden.at(0).added, Lines{"jdoe:(hidden):19000::::::"});
    EXPECT_EQ(changesBetween(before, after, Secrets::Show).at(0).added,
              Lines{"jdoe:$6$salt$hash:19000::::::"});
}

TEST(AccountFileChanges, HideHashesInEveryAccountFile)
{
    for (char const* file : {"/etc/passwd", "/etc/shadow", "/etc/group", "/etc/gshadow"}) {
        AccountFiles const after = {{file, {"jdoe:$6$salt$hash:1000:100::/:/bin/sh"}}};
        EXPECT_EQ(changesBetween({}, after, Secrets::Hide).at(0).added,
                  Lines{"jdoe:(hidden):1000:100::/:/bin/sh"})
            << file;
    }
}

TEST(AccountFileChanges, HideHashesOfBrokenLines)
{
    AccountFiles const after = {{"/etc/shadow", {"jdoe:secret", "noColonAtAll"}}};
    EXPECT_EQ(changesBetween({}, after, Secrets::Hide).at(0).added,
              (Lines{"jdoe:(hidden)", "noColonAtAll"}));
}

} // namespace account_changes_test
