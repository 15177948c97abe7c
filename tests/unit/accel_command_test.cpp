#include "mihost/accel/Command.h"

#include <gtest/gtest.h>

namespace
{

using miaccel::Kind;
using miaccel::recognise;

TEST(AccelCommand, KnowsTheCommandsOfThePlugIn)
{
    auto const wc = recognise("wc -l /var/log/messages");
    ASSERT_TRUE(wc);
    EXPECT_EQ(wc->kind, Kind::Wc);
    EXPECT_EQ(wc->name, "/var/log/messages");

    auto const sed = recognise("sed -n '120p' /var/log/messages");
    ASSERT_TRUE(sed);
    EXPECT_EQ(sed->kind, Kind::Sed);
    EXPECT_EQ(sed->name, "/var/log/messages");
    EXPECT_EQ(sed->line, 120U);

    auto const modinfo = recognise("modinfo snd_hda_intel");
    ASSERT_TRUE(modinfo);
    EXPECT_EQ(modinfo->kind, Kind::Modinfo);
    EXPECT_EQ(modinfo->name, "snd_hda_intel");

    ASSERT_TRUE(recognise("date"));
    EXPECT_EQ(recognise("date")->kind, Kind::Date);
    ASSERT_TRUE(recognise("lsmod"));
    EXPECT_EQ(recognise("lsmod")->kind, Kind::Lsmod);
}

TEST(AccelCommand, ReadsWordsAsAShellDoes)
{
    auto const command = recognise(" \t'sed'  '-n'\t123p 'a+b,c:d@e.f_g-h'  ");
    ASSERT_TRUE(command);
    EXPECT_EQ(command->kind, Kind::Sed);
    EXPECT_EQ(command->name, "a+b,c:d@e.f_g-h");
    EXPECT_EQ(command->line, 123U);
}

TEST(AccelCommand, TakesLineNumbersOfUpTo18Digits)
{
    ASSERT_TRUE(recognise("sed -n '999999999999999999p' f"));
    EXPECT_EQ(recognise("sed -n '999999999999999999p' f")->line, 999999999999999999U);
    EXPECT_FALSE(recognise("sed -n '1000000000000000000p' f"));
}

TEST(AccelCommand, LeavesEverythingElseToTheShell)
{
    for (char const* line :
         {"", " ", "''", "echo hi", "/usr/bin/date", "./date", "Date", "datex",
          // what a shell makes something of
          "date;", "date&", "date|cat", "date>x", "date #", "date\n", "date\r", "wc -l $HOME",
          "wc -l \"f\"", "wc -l ~", "wc -l f*", "wc -l f?", "wc -l [f]", "wc -l {f,g}", "wc -l `f`",
          "wc -l f\\", "wc -l 'f", "wc -l 'f g'", "wc -l f'g'", "wc -l 'f'g", "wc -l a=b",
          "wc -l a%b", "wc -l a!b", "wc -l a^b", "wc -l (a)", "LC_ALL=x date", "wc -l ''",
          "wc -l \x80",
          // other operands
          "wc", "wc -l", "wc f", "wc -c f", "wc -l f g", "wc -l -", "wc -l -c", "wc -l --help",
          "wc -ll f", "date -u", "date now", "lsmod -v", "lsmod x", "modinfo", "modinfo -a",
          "modinfo a b", "modinfo a.ko", "modinfo ./a", "modinfo /a", "modinfo pci:x",
          "modinfo a,b", "sed", "sed -n", "sed -n 1p", "sed -n '1p'", "sed 1p f", "sed -n 1p f g",
          "sed -n 1p -", "sed -n 1p -i", "sed -n 1d f", "sed -n p f", "sed -n '' f",
          "sed -n '$p' f", "sed -n '1,2p' f", "sed -n '1q' f", "sed -n '1pp' f", "sed -n +1p f",
          "sed -n -1p f",
          // refused by sed itself
          "sed -n '0p' f", "sed -n '00p' f", "sed -n '01p' f"})
        EXPECT_FALSE(recognise(line)) << line;
}

} // namespace
