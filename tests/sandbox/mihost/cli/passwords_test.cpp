// A password that was set opens the account, whatever this passwd supports, and is shown nowhere.

#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <algorithm>
#include <crypt.h>
#include <cstdlib>
#include <gtest/gtest.h>

namespace passwords_test
{

constexpr char password[] = "geheim42";

bool holds(std::string const& text, std::string const& part)
{
    return text.find(part) != std::string::npos;
}

/** Whether a login with the password succeeds. */
bool opens(std::string const& account)
{
    std::string const hash = machine::entry("/etc/shadow", account).at(1);
    char const* const again = crypt(password, hash.c_str());
    return again && !hash.empty() && hash == again;
}

class Passwords : public testing::Test
{
protected:
    Passwords()
    {
        machine::lay("plain");
        EXPECT_EQ(std::system("/usr/sbin/useradd -M -s /bin/sh -c 'J. Doe' jdoe"), 0);
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
        ASSERT_EQ(std::system("usermod -p '!' jdoe"), 0);
        Outcome const outcome =
            mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=-"}, "geheim42\n");
        EXPECT_EQ(outcome.code, 0) << row.method;
        EXPECT_EQ(outcome.out + outcome.err, "") << row.method;
        EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1).rfind(row.prefix, 0), 0U)
            << row.method;
        EXPECT_TRUE(opens("jdoe")) << row.method;
    }
}

TEST_F(Passwords, OpenANewAccountIfPasswdReadsNone)
{
    makePasswdPlain();
    EXPECT_EQ(mihostRun({"call", "UserAdd", "UserName=new", "Password=geheim42"}).code, 0);
    EXPECT_TRUE(opens("new"));
}

TEST_F(Passwords, OpenTheAccountIfTheCallIsWrittenAsText)
{
    makePasswdPlain();
    Outcome const outcome =
        mihostRun({"set", "os", "create-user",
                   "UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:geheim42"});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_TRUE(opens("jdoe"));
}

TEST_F(Passwords, OpenTheAccountWithThisMachinesOwnPasswd)
{
    EXPECT_EQ(mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"}).code, 0);
    EXPECT_TRUE(opens("jdoe"));
}

TEST_F(Passwords, ArePassedUnchangedIfPasswdReadsThem)
{
    makePasswdReadStdin();
    machine::recordShell();
    Outcome const outcome =
        mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.out + outcome.err, "");
    EXPECT_TRUE(opens("jdoe"));
    Lines const ran = machine::ran();
    EXPECT_NE(std::find(ran.begin(), ran.end(), "/usr/sbin/usermod -p geheim42 jdoe 2>&1"),
              ran.end());
}

TEST_F(Passwords, ThatPasswdDropsAreReported)
{
    machine::fake("/usr/bin/passwd", "[ \"$1\" = --help ] && echo '  --stdin'\nexit 1\n");
    Outcome const outcome =
        mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.err, "mihost: call UserSetPassword: password of jdoe is another one, not the "
                           "given one\n");
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
        EXPECT_TRUE(holds(shown, "(hidden)")) << shown;
        for (std::string const part : {"geheim42", "$6$", "$y$", "\\$6", "\\$y"})
            EXPECT_FALSE(holds(shown, part)) << part << ": " << shown;
    }
}

TEST_F(Passwords, AreRefusedIfStandardInputIsEmpty)
{
    Outcome const outcome =
        mihostRun({"call", "UserSetPassword", "UserName=jdoe", "Password=-"}, "");
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.err, "mihost: Password: standard input is empty\n");
}

} // namespace passwords_test
