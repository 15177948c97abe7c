#include "mihost/accel/CommandForm.h"

#include <gtest/gtest.h>

namespace command_form_test
{

using miaccel::operandsOf;

constexpr char const* wc = "wc -l @";
constexpr char const* sed = "sed -n '#p' @";
constexpr char const* modinfo = "modinfo ~";

TEST(AccelCommand, KnowsTheCommandsOfThePlugin)
{
    EXPECT_EQ(operandsOf(wc, "wc -l /var/log/messages").value().name, "/var/log/messages");
    EXPECT_EQ(operandsOf(sed, "sed -n '120p' /var/log/messages").value().name, "/var/log/messages");
    EXPECT_EQ(operandsOf(sed, "sed -n '120p' f").value().line, 120U);
    EXPECT_EQ(operandsOf(sed, "sed -n '999999999999999999p' f").value().line, 999999999999999999U);
    EXPECT_EQ(operandsOf(modinfo, "modinfo snd_hda-intel").value().name, "snd_hda-intel");
    EXPECT_TRUE(operandsOf("date", "date"));
}

TEST(AccelCommand, LeavesEverythingElseToTheShell)
{
    for (char const* line :
         {"", " ", "echo hi", "/usr/bin/date", "./date", "Date", "datex", " date", "date ",
          // characters with a meaning in a shell
          "date;", "date&", "date|cat", "date>x", "date #", "date\n", "wc -l $HOME", "wc -l \"f\"",
          "wc -l ~", "wc -l f*", "wc -l f?", "wc -l [f]", "wc -l {f,g}", "wc -l `f`", "wc -l f\\",
          "wc -l 'f", "wc -l 'f g'", "wc -l f'g'", "wc -l a=b", "wc -l a%b", "wc -l a!b",
          "wc -l (a)", "LC_ALL=x date", "wc -l ''", "wc -l \x80",
          // other operands
          "wc", "wc -l", "wc -l ", "wc f", "wc -c f", "wc -l f g", "wc -l -", "wc -l -c",
          "wc -l --help", "wc -ll f", "date -u", "date now", "modinfo", "modinfo ", "modinfo -a",
          "modinfo a b", "modinfo a.ko", "modinfo ./a", "modinfo /a", "modinfo pci:x",
          "modinfo a,b", "sed", "sed -n", "sed -n 1p f", "sed -n '1p'", "sed '1p' f",
          "sed -n '1p' f g", "sed -n '1p' -", "sed -n '1p' -i", "sed -n '1d' f", "sed -n 'p' f",
          "sed -n '' f", "sed -n '$p' f", "sed -n '1,2p' f", "sed -n '1q' f", "sed -n '1pp' f",
          "sed -n '+1p' f", "sed -n '-1p' f", "sed -n '1000000000000000000p' f",
          // some versions of sed refuse these
          "sed -n '0p' f", "sed -n '00p' f", "sed -n '01p' f"})
        for (char const* form : {wc, sed, "date", modinfo})
            EXPECT_FALSE(operandsOf(form, line)) << line;
}

} // namespace command_form_test
