// executeCommand and executePasswordEncryption.

#include "tests/interpose/Libc.h"
#include "tests/sysdata/MethodTest.h"

#include <array>

namespace method_runner_test
{

constexpr std::size_t bufferSize = 5000;

class ExecuteCommand : public MethodTest
{
protected:
    /** Runs a program with the arguments; an empty one is appended. */
    int run(std::string program, Lines arguments)
    {
        std::string slot = "(the program's own entry)";
        std::string end;
        std::vector<char*> entries{slot.data()};
        for (std::string& argument : arguments)
            entries.push_back(argument.data());
        entries.push_back(end.data());
        return NQ::OsInfo().executeCommand(program.data(), entries.data(), output_.data());
    }

    std::string said() const
    {
        return output_.data();
    }

    std::array<char, bufferSize + 1> output_{}; // the runner must not write the last byte
};

TEST_F(ExecuteCommand, JoinsTheProgramAndItsArgumentsByBlanks)
{
    struct {
        char const* program;
        Lines arguments;
        char const* line;
    } const cases[] = {
        {"/bin/one", {"-a", "two  three", "'"}, "/bin/one -a two  three ' 2>&1"},
        {"/bin/one", {}, "/bin/one 2>&1"},
        {"/bin/one", {"-a", "", "-b"}, "/bin/one -a 2>&1"},
        {"/usr/sbin/useradd", {"jdoe"}, "/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1"},
        {"/bin/echo", {"-useradd-"}, "/bin/echo -useradd- 2>&1;echo rc=$? 2>&1"},
        {"/usr/sbin/userad", {"d"}, "/usr/sbin/userad d 2>&1"},
    };
    for (auto const& [program, arguments, line] : cases) {
        EXPECT_EQ(run(program, arguments), 0);
        EXPECT_EQ(commands_.ran.back(), line);
    }
}

TEST_F(ExecuteCommand, CopiesTheOutputAndReportsAny)
{
    commands_.status = 1 << 8;
    for (std::string const& output :
         {std::string(), std::string("\n"), std::string("one\ntwo\n\nthree"),
          std::string("one\0two", 7), std::string(bufferSize - 1, 'x')}) {
        output_.fill('#');
        commands_.otherwise = output;
        EXPECT_EQ(run("/bin/one", {}), output.empty() ? 0 : 1);
        EXPECT_EQ(std::string(output_.data(), output.size() + 2), output + std::string("\0#", 2));
        EXPECT_EQ(commands_.open, 0);
    }
}

TEST_F(ExecuteCommand, FailsIfThePipeCannotBeOpened)
{
    commands_.otherwise.reset();
    output_.fill('#');
    Recording const log;
    EXPECT_EQ(run("/bin/one", {"-p", "argument"}), 1);
    EXPECT_EQ(said(), "");
    EXPECT_EQ(log.texts(), (Lines{"executeCommand: entry", "Cannot open process: /bin/one",
                                  "executeCommand: exit"}));
    EXPECT_EQ(log.texts(6000), Lines{"Cannot open process: /bin/one"});
}

TEST_F(ExecuteCommand, ReadsLongerOutputToItsEndAndCutsIt)
{
    std::string const whole = std::string(bufferSize - 1, 'x') + std::string(100000, 'y');
    long read = -1;
    auto const close = libc::hooks().pclose.answer();
    libc::hooks().pclose = [&](FILE* stream) {
        read = std::ftell(stream);
        return close(stream);
    };
    commands_.otherwise = whole;
    output_.fill('#');
    EXPECT_EQ(run("/bin/one", {}), 1);
    EXPECT_EQ(said(), std::string(bufferSize - 1, 'x'));
    EXPECT_EQ(output_.back(), '#');
    EXPECT_EQ(read, static_cast<long>(whole.size()));
}

TEST_F(ExecuteCommand, RunsALineThatJustFitsAndNoLongerOne)
{
    // Besides the argument: "/bin/one", a blank and " 2>&1".
    std::size_t const room = bufferSize - 1 - 8 - 1 - 5;
    EXPECT_EQ(run("/bin/one", {std::string(room, 'x')}), 0);
    ASSERT_EQ(commands_.ran.size(), 1U);
    EXPECT_EQ(commands_.ran.front(), "/bin/one " + std::string(room, 'x') + " 2>&1");

    Recording const log;
    output_.fill('#');
    EXPECT_EQ(run("/bin/one", {std::string(room + 1, 'x')}), 1);
    EXPECT_EQ(commands_.ran.size(), 1U);
    EXPECT_EQ(said(), "");
    EXPECT_EQ(log.texts(6000), Lines{"Command line too long: /bin/one"});
}

TEST_F(ExecuteCommand, CountsTheEchoedCodeAsPartOfTheLine)
{
    // Besides the argument: the program, a blank, " 2>&1;echo rc=$?" and " 2>&1".
    std::size_t const room = bufferSize - 1 - 17 - 1 - 16 - 5;
    EXPECT_EQ(run("/usr/sbin/useradd", {std::string(room, 'x')}), 0);
    EXPECT_EQ(run("/usr/sbin/useradd", {std::string(room + 1, 'x')}), 1);
    EXPECT_EQ(commands_.ran.size(), 1U);
}

class PasswordEncryption : public MethodTest
{
protected:
    static void set(std::string password, std::string user)
    {
        NQ::OsInfo().executePasswordEncryption(password.data(), user.data());
    }
};

TEST_F(PasswordEncryption, EchoesItIntoPasswdAndIgnoresTheOutput)
{
    commands_.otherwise = "BAD PASSWORD\n";
    Recording const log;
    set("secret", "jdoe");
    EXPECT_EQ(commands_.ran, Lines{"echo secret | /usr/bin/passwd jdoe --stdin 2>&1"});
    EXPECT_EQ(commands_.open, 0);
    EXPECT_EQ(log.texts(), (Lines{"executePasswordEncryption: entry", "executeCommand: entry",
                                  "executeCommand: exit", "executePasswordEncryption: exit"}));
}

TEST_F(PasswordEncryption, RunsNothingWithoutAUserName)
{
    Recording const log;
    set("secret", "");
    EXPECT_EQ(commands_.ran, Lines());
    EXPECT_EQ(log.texts(6000), Lines{"No user name for the password"});
}

TEST_F(PasswordEncryption, IsLimitedOnlyByTheRunnersBuffer)
{
    std::string const ends = "echo  | /usr/bin/passwd jdoe --stdin 2>&1";
    std::string const longest(4999 - ends.size(), 'x');
    set(longest, "jdoe");
    EXPECT_EQ(commands_.ran, Lines{"echo " + longest + " | /usr/bin/passwd jdoe --stdin 2>&1"});
    Recording const log;
    set(longest + "x", "jdoe");
    EXPECT_EQ(commands_.ran.size(), 1U);
    EXPECT_EQ(log.texts(6000), Lines{"Command line too long: echo"});
}

TEST_F(PasswordEncryption, EndsTheLineAtAnEmptyPassword)
{
    set("", "jdoe");
    EXPECT_EQ(commands_.ran, Lines{"echo 2>&1"});
}

} // namespace method_runner_test
