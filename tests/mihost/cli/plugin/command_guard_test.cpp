#include "mihost/cli/plugin/CommandGuard.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

namespace command_guard_test
{

using mihost::objectionToCommand;

TEST(CommandGuard, PassesTheCommandLinesOfThePlugin)
{
    for (char const* line :
         {"lsmod",
          "modinfo nf_tables",
          "wc -l /var/log/messages",
          "sed -n '17p' /var/log/messages",
          "date",
          "chage -l jdoe",
          "chage -I 30 jdoe",
          "chage -M 99999 jdoe",
          "userdel -r 1500",
          "chpasswd -e < usrandpwd ; rm -f usrandpwd",
          "/sbin/shutdown -h now",
          "/sbin/shutdown -r now",
          "/usr/sbin/useradd jdoe -c John\\ Smith 2>&1;echo rc=$? 2>&1",
          "/usr/sbin/useradd -n jdoe -p \\$6\\$salt\\$hash 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E -1 jdoe 2>&1",
          "/usr/bin/id \"jdoe\" 2>&1",
          "/usr/sbin/usermod -G jdoe,\"jdoe\",\"domain users\",\"crew\" \"jdoe\" 2>&1",
          "echo secret | /usr/bin/passwd jdoe --stdin 2>&1",
          "stat /etc/redhat-release | grep Change",
          "cat /etc/redhat-release  | tr -d '[:alpha:][:space:][()]'",
          "echo $(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 9).$(cat "
          "/etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 12) | tr -d [:space:]"})
        EXPECT_EQ(objectionToCommand(line), std::nullopt) << line;
}

TEST(CommandGuard, RefusesEachByteWithAMeaningInAShell)
{
    struct Line {
        std::string before;
        std::string after;
    };
    for (Line const& line :
         std::initializer_list<Line>{{"modinfo a", "b"},
                                     {"chage -l a", "b"},
                                     {"userdel -r a", "b"},
                                     {"sed -n '1", "p' /var/log/messages"},
                                     {"/usr/sbin/useradd a", "b 2>&1;echo rc=$? 2>&1"},
                                     {"/usr/bin/id \"a", "b\" 2>&1"},
                                     {"/usr/sbin/usermod -G a", "b,\"c\" \"jdoe\" 2>&1"},
                                     {"/usr/sbin/usermod -G a,\"b", "\" \"jdoe\" 2>&1"},
                                     {"echo a", "b | /usr/bin/passwd jdoe --stdin 2>&1"},
                                     {"echo a | /usr/bin/passwd a", "b --stdin 2>&1"}})
        for (int byte = 1; byte < 256; ++byte) {
            bool const isModule = line.before.rfind("modinfo", 0) == 0;
            // Two bytes, since a backslash may escape the one after it.
            std::string const text = line.before + static_cast<char>(byte) + ";" + line.after;
            if (byte != '\\' || isModule) {
                EXPECT_NE(objectionToCommand(text), std::nullopt) << text;
            }
            bool const isActedOn =
                byte < 0x20 || byte == 0x7F ||
                (byte < 0x80 && std::strchr("|&;<>()$`\"'*?[]#~=%!{}^", byte) != nullptr);
            if (isActedOn) {
                EXPECT_NE(objectionToCommand(line.before + static_cast<char>(byte) + line.after),
                          std::nullopt)
                    << line.before << static_cast<char>(byte) << line.after;
            }
        }
}

TEST(CommandGuard, RefusesLinesThatFitTwoOfThePluginsCommands)
{
    for (char const* line :
         {"lsmod; reboot", "lsmod\nreboot", "chage -l a 2>&1;echo rc=$? 2>&1;reboot",
          "chage -l a 2>&1 2>&1;echo rc=$? 2>&1", "echo a | /usr/bin/passwd b | sh 2>&1",
          "echo a | sh 2>&1", "chpasswd -e < usrandpwd ; rm -f usrandpwd;reboot",
          "/usr/bin/id \"a 2>&1", "modinfo a\\", "chage -l a\\"})
        EXPECT_NE(objectionToCommand(line), std::nullopt) << line;
}

TEST(CommandGuard, RefusesModuleNamesThatLookLikeOptions)
{
    EXPECT_EQ(objectionToCommand("modinfo -x"),
              "the name of the module '-x' begins with '-', so a command would read it as an "
              "option");
    EXPECT_EQ(objectionToCommand("modinfo x;reboot"),
              "the name of the module 'x;reboot' contains the shell metacharacter ';'");
}

TEST(CommandGuard, NamesNoPartOfALineThatMayHoldAPassword)
{
    std::string const reason =
        objectionToCommand("echo sec;ret | /usr/bin/passwd a --stdin").value();
    EXPECT_EQ(reason, "it contains the shell metacharacter ';'");
}

} // namespace command_guard_test
