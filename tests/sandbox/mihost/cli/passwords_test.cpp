// A password that was set opens the account, whatever this passwd supports, and is shown nowhere.

#include "tests/sandbox/mihost/cli/Login.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <algorithm>

namespace passwords_test
{

class Passwords : public testing::Test
{
protected:
    Passwords()
    {
        machine::lay("small");
    }

    /** A passwd without --stdin, such as Debian's. */
    static void makePasswdPlain()
    {
        machine::fake("/usr/bin/passwd", "[ \"$1\" = --help ] && { echo Usage: passwd; exit 0; }\n"
                                         "cat >/dev/null\n"
                                         "echo \"passwd: unrecognized option '--stdin'\"\n"
                                         "exit 6\n");
    }

    /** A passwd with --stdin, such as Red Hat's. */
    static void makePasswdReadStdin()
    {
        machine::fake("/usr/bin/passwd", "[ \"$1\" = --help ] && { echo '  --stdin'; exit 0; }\n"
                                         "read password\n"
                                         "echo \"$1:$password\" | /usr/sbin/chpasswd -c SHA512\n"
                                         "echo 'passwd: all tokens updated successfully.'\n");
    }

    static void setMethod(std::string const& name)
    {
        machine::write("/etc/login.defs",
                       machine::read("/etc/login.defs") + "\nENCRYPT_METHOD " + name + "\n");
    }
};

TEST_F(Passwords, OpenTheAccountIfPasswdReadsNone)
{
    makePasswdPlain();
    struct Row {
        char const* method;
        char const* prefix;
    };
    for (Row const& row : {Row{"YESCRYPT", "$y$"}, Row{"SHA512", "$6$"}, Row{"SHA256", "$5$"},
                           Row{"BCRYPT", "$2b$"}, Row{"MD5", "$y$"}}) {
        setMethod(row.method);
        machine::run("usermod -p '!' jdoe");
        EXPECT_EQ(
            mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=-"}, "geheim42\n"),
            printed(""));
        EXPECT_TRUE(startsWith(machine::entry("/etc/shadow", "jdoe").at(1), row.prefix))
            << row.method;
        EXPECT_TRUE(opens("jdoe", "geheim42")) << row.method;
    }
}

TEST_F(Passwords, OpenTheAccountOfAnyCallIfPasswdReadsNone)
{
    makePasswdPlain();
    EXPECT_EQ(mihostRun({"call", "UserAdd", "UserName=new", "Password=geheim42"}).code, 0);
    EXPECT_TRUE(opens("new", "geheim42"));
    EXPECT_EQ(
        mihostRun({"set", "os", "create-user",
                   "UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:geheim42"}),
        printed(""));
    EXPECT_TRUE(opens("jdoe", "geheim42"));
}

TEST_F(Passwords, ArePassedUnchangedIfPasswdReadsThem)
{
    makePasswdReadStdin();
    machine::recordShell();
    EXPECT_EQ(mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"}),
              printed(""));
    EXPECT_TRUE(opens("jdoe", "geheim42"));
    Lines const ran = machine::ran();
    EXPECT_NE(std::find(ran.begin(), ran.end(), "/usr/sbin/usermod -p geheim42 jdoe 2>&1"),
              ran.end());
}

TEST_F(Passwords, ThatPasswdDropsAreReported)
{
    machine::fake("/usr/bin/passwd", "[ \"$1\" = --help ] && echo '  --stdin'\nexit 1\n");
    EXPECT_EQ(mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"}),
              failed(1, "call UserSetPassword: password of jdoe is another one, not the "
                        "given one"));
}

TEST_F(Passwords, AreInNoOutputTraceOrMessage)
{
    makePasswdPlain();
    // A tool that repeats what it was given, which fails the call.
    machine::fake("/usr/sbin/usermod", "echo \"invalid: '$2'\"\nexit 1\n");
    for (char const* format : {"--json", "--yes"}) {
        Outcome const outcome = mihostRun({format, "--trace", "/tmp/trace", "call",
                                           "UserSetPassword", "UserName=jdoe", "Password=-"},
                                          "geheim42\nnext line\n");
        EXPECT_EQ(outcome.code, 1);
        std::string const shown = outcome.out + outcome.err + machine::read("/tmp/trace");
        EXPECT_TRUE(holds(shown, "(hidden)"));
        for (std::string const part : {"geheim42", "$6$", "$y$", "\\$6", "\\$y"})
            EXPECT_FALSE(holds(shown, part));
    }
}

} // namespace passwords_test
