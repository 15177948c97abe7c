// The whole program, with a recorder in place of the shell: hostile arguments of every command and
// hostile names on the machine run nothing.

#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/input/Command.h"
#include "mihost/cli/plugin/CommandGuard.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <algorithm>
#include <cctype>
#include <cstring>
#include <filesystem>

namespace hostile_arguments_test
{

constexpr char mark[] = "/tmp/pwned";

std::string quoted(std::string const& word)
{
    std::string text = "'";
    for (char const byte : word)
        text += byte == '\'' ? "'\\''" : std::string(1, byte);
    return text + "'";
}

/** One for each way to begin a command. Line ends, which no line of a script has, are apart. */
Lines hostileWords()
{
    return {"x;touch /tmp/pwned",           "x`touch /tmp/pwned`",    "x$(touch /tmp/pwned)",
            "x\" |touch \xFF/tmp/pwned \"", "x' &touch /tmp/pwned '", "x\\;touch${IFS}/tmp/pwned"};
}

/** One special byte each: no letter, digit or line end. */
Lines hostileBytes()
{
    Lines words;
    for (int byte = 1; byte < 256; ++byte)
        if (byte != '\n' && !std::isalnum(byte))
            words.push_back(std::string("x") + static_cast<char>(byte) + "y");
    return words;
}

/** Every command, with {} in place of each of its arguments and option values. */
Lines commandLines()
{
    std::pair<char const*, Lines> const commands[] = {
        {"", {"{}", "--lock-timeout {} refresh"}},
        {"refresh", {"{}"}},
        {"clear-log --yes", {"{}"}},
        {"power --yes", {"{}"}},
        {"version", {"{}"}},
        {"doctor", {"{}"}},
        {"properties", {"{}"}},
        {"methods", {"{}"}},
        {"help", {"{}"}},
        {"tree", {"{}", "--all={}"}},
        {"list", {"{}", "users --columns {}", "log -n {}", "log --since {}", "log --until {}"}},
        {"get", {"{}", "os {}", "user:{}", "group:{}", "driver:{}", "log:{}"}},
        {"watch --count 1", {"{} os-name", "os {}", "os os-name --interval {}"}},
        {"watch os os-name", {"--count {}"}},
        {"set --yes", {"{} delete true", "user:jdoe {} true", "user:{} delete true"}},
        {"set user:jdoe", {"user-name {}", "user-id {}"}},
        {"call", {"{}", "UserDel {}", "UserDel {}=jdoe", "UserDel UserName={}"}},
        {"user", {"{}", "add {}", "delete --yes {}", "set-password {}"}},
        {"user set-password jdoe", {"--password-file {}"}},
        {"user set-shell", {"{} /bin/sh", "jdoe {}"}},
        {"user set-home", {"{} /srv", "jdoe {}"}},
        {"user set-name", {"{} Name", "jdoe {}"}},
        {"user expire", {"{} never", "jdoe {}"}},
        {"user age", {"{} --max-days 1", "jdoe --max-days {}"}},
        {"group", {"{}", "add {}", "delete --yes {}"}},
        {"group add-member", {"{} jdoe", "crew {}"}},
        {"group remove-member", {"{} jdoe", "crew {}"}}};
    Lines lines;
    for (auto const& [command, arguments] : commands)
        for (std::string const& argument : arguments)
            lines.push_back(std::string(command) + ' ' + argument);
    for (char const* option : {"full-name", "home", "shell", "password-file", "expires", "min-days",
                               "max-days", "warn-days", "inactive-days"})
        lines.push_back("user add asmith --" + std::string(option) + " {}");
    for (mihost::NodeKind const& kind : mihost::nodeKinds())
        for (mihost::Property const& property : kind.properties)
            if (property.has(mihost::Property::Acts))
                lines.push_back(std::string("set ") + (kind.single ? kind.address : "user:jdoe") +
                                " " + property.name + " {} --yes");
    for (mihost::Method const& method : mihost::methods())
        for (mihost::Parameter const& parameter : method.parameters) {
            std::string line = "call " + std::string(method.name) + " --yes";
            for (mihost::Parameter const& other : method.parameters)
                if (&other == &parameter)
                    line += std::string(" ") + other.name + "={}";
                else if (other.required)
                    line += std::string(" ") + other.name + "=jdoe";
            lines.push_back(line);
        }
    return lines;
}

std::string filled(std::string line, std::string const& word)
{
    return line.replace(line.find("{}"), 2, quoted(word));
}

bool isPartOfSafeNames(int byte)
{
    return byte < 0x80 && (std::isalnum(byte) || std::strchr("@+-./_", byte) != nullptr);
}

void expectHarmless(Lines const& ran)
{
    for (std::string const& line : ran)
        EXPECT_EQ(mihost::objectionToCommand(line), std::nullopt) << line;
    EXPECT_FALSE(std::filesystem::exists(mark));
}

class InjectionInto : public testing::Test
{
protected:
    InjectionInto()
    {
        machine::lay("plain");
        machine::write("/etc/passwd", "root:x:0:0::/root:/bin/sh\njdoe:x:1000:1000::/:/bin/sh\n");
        machine::write("/etc/group", "root:x:0:\njdoe:x:1000:\ncrew:x:1001:\n");
        machine::fake("/usr/sbin/lsmod", "echo Module Size\n");
        for (char const* tool : {"/usr/sbin/usermod", "/usr/bin/chage", "/usr/sbin/userdel",
                                 "/usr/sbin/useradd", "/usr/sbin/groupadd", "/usr/sbin/groupdel"})
            machine::fake(tool, "exit 0\n");
        machine::recordShell();
    }

    /** The command lines of a script without commands. */
    static Lines startLines()
    {
        EXPECT_EQ(mihostRun({"shell"}).code, 0);
        Lines const ran = machine::ran();
        machine::forget();
        return ran;
    }

    /** Runs a script. @return how many of its lines were refused */
    static std::size_t refusedLinesOf(std::string const& script)
    {
        Lines const results = linesOf(mihostRun({"--json", "shell", "--keep-going"}, script).out);
        return static_cast<std::size_t>(
            std::count_if(results.begin(), results.end(), [](std::string const& line) {
                return Json::parse(line).value("exit", 0) == 2;
            }));
    }
};

TEST_F(InjectionInto, AnyArgumentOfAnyCommandReachesNoShell)
{
    Lines const start = startLines();
    Lines const words = hostileWords();
    Lines const bytes = hostileBytes();
    std::string script;
    std::size_t count = 0;
    for (std::string const& line : commandLines()) {
        Lines all = words;
        if (line == "get {}") // a unit test has those of methods
            all.insert(all.end(), bytes.begin(), bytes.end());
        for (std::string const& word : all) {
            // A name can hold these.
            if (word.size() == 3 && isPartOfSafeNames(static_cast<unsigned char>(word[1])))
                continue;
            script += filled(line, word) + "\n";
            ++count;
        }
    }
    Outcome const outcome = mihostRun({"--json", "shell", "--keep-going"}, script);
    Lines const results = linesOf(outcome.out);
    EXPECT_EQ(results.size(), count);
    Lines const commands = linesOf(script);
    for (std::size_t at = 0; at < std::min(results.size(), commands.size()); ++at) {
        Json const result = Json::parse(results[at]);
        int const code = result.is_object() ? result.value("exit", 0) : 0;
        EXPECT_TRUE(code == 2 || code == 4) << commands[at] << ": " << results[at];
    }
    EXPECT_EQ(linesOf(outcome.err).size(), count); // one line each
    EXPECT_EQ(machine::ran(), start);
    expectHarmless(start);
}

TEST_F(InjectionInto, AnyOptionOfTheProgramReachesNoShell)
{
    for (std::string const& word : hostileWords()) {
        EXPECT_EQ(mihostRun({"--plugin", word, "tree"}).code, 3) << word;
        EXPECT_EQ(mihostRun({"--overlay", word, "tree"}).code, 2) << word;
        mihostRun({"--trace", word, "get", "os", "os-name"}); // some are names of files
        mihostRun({"__complete", word, "get", word});
        mihostRun({"__complete-bash", "mihost get " + word, word});
    }
    expectHarmless(machine::ran());
}

TEST_F(InjectionInto, AnyFileOfMetricsReachesNoShell)
{
    for (std::string const& word : hostileWords()) {
        EXPECT_EQ(mihostRun({"metrics", word}).code, 2) << word;
        mihostRun({"metrics", "--output", word}); // some are names of files
    }
    for (std::string const& line : machine::ran())
        EXPECT_FALSE(holds(line, "pwned")); // the doctor's own lines have pipes
    EXPECT_FALSE(std::filesystem::exists(mark));
}

TEST_F(InjectionInto, AnArgumentWithALineEndReachesNoShell)
{
    for (Lines const& arguments :
         {Lines{"call", "UserDel", "UserName=x\ntouch /tmp/pwned"},
          Lines{"call", "UserDel", "UserName=jdoe\n"}, Lines{"get", "x\ntouch /tmp/pwned"},
          Lines{"set", "user:jdoe", "password", "$6$salt$hash\nroot:$6$salt$hash"},
          Lines{"set", "os", "create-user", "UserDel,UserName:CMPI_string:x\ntouch /tmp/pwned"},
          Lines{"x\ntouch /tmp/pwned"}}) {
        Outcome const outcome = mihostRun(arguments);
        EXPECT_TRUE(outcome.code == 2 || outcome.code == 4) << arguments[0];
        EXPECT_EQ(linesOf(outcome.err).size(), 1U) << outcome.err;
    }
    expectHarmless(machine::ran());
}

TEST_F(InjectionInto, AnyAccountNameReachesNoShell)
{
    std::string accounts = machine::read("/etc/passwd");
    std::string script;
    Lines harmless;
    std::size_t count = 0;
    for (int byte = 1; byte < 256; ++byte) {
        if (byte == ':' || byte == '\n')
            continue; // no name in that file can hold them
        std::string const name = std::string("a") + static_cast<char>(byte) + "b";
        if (std::isalnum(byte) && byte != 'a')
            continue;
        accounts += name + ":x:" + std::to_string(2000 + byte) + ":1000::/:/bin/sh\n";
        script += "set " + quoted("user:" + name) + " inactive-time 2030-01-01\n";
        ++count;
        if (isPartOfSafeNames(byte))
            harmless.push_back(name);
    }
    for (char const* name : {"x`touch /tmp/pwned`", "x;touch /tmp/pwned", "x$(touch /tmp/pwned)"}) {
        accounts += std::string(name) + ":x:1500:1000::/:/bin/sh\n";
        for (char const* write : {"password '$6$salt$hash'", "inactive-time 2030-01-01",
                                  "password-expiration 2030-01-01", "delete true --yes"}) {
            script += "set " + quoted(std::string("user:") + name) + " " + write + "\n";
            ++count;
        }
    }
    machine::write("/etc/passwd", accounts);
    Lines const start = startLines();
    EXPECT_EQ(refusedLinesOf(script), count - harmless.size());
    Lines ran = machine::ran();
    expectHarmless(ran);
    for (std::string const& name : harmless)
        EXPECT_NE(std::find(ran.begin(), ran.end(), "chage -l " + name), ran.end()) << name;
    EXPECT_EQ(ran.size(), start.size() + 2 * harmless.size()); // chage -l and chage -I each
}

TEST_F(InjectionInto, AnyGroupNameReachesNoShell)
{
    std::string accounts = machine::read("/etc/passwd");
    std::string groups = machine::read("/etc/group");
    std::string script;
    std::size_t count = 0;
    std::size_t harmless = 0;
    Lines names = {"x`touch${IFS}/tmp/pwned`",
                   "x;touch /tmp/pwned",
                   "x$(touch /tmp/pwned)",
                   "x)(root",
                   "0",
                   "x\"\"y"};
    for (std::string const& name : hostileBytes())
        if (name[1] != ':' && name[1] != ',') // which end a name in that file
            names.push_back(name);
    for (std::string const& name : names) {
        std::string const id = std::to_string(2000 + count);
        std::string const member = "m" + id;
        accounts += member + ":x:" + id + ":1000::/:/bin/sh\n";
        groups += name + ":x:" + id + ":" + member + "\n";
        script += "call LocalGroupAddUser LocalGroupName=crew DomainAndMember=" + member + "\n";
        ++count;
        bool const isByte = name.size() == 3;
        auto const byte = static_cast<unsigned char>(name[1]);
        if (isByte && (isPartOfSafeNames(byte) || byte == ' ')) // in quotes there
            ++harmless;
    }
    machine::write("/etc/passwd", accounts);
    machine::write("/etc/group", groups);
    machine::write("/etc/login.defs", "UID_MIN 1000\nUID_MAX 1000\nGID_MIN 1000\nGID_MAX 1001\n");
    EXPECT_EQ(refusedLinesOf(script), count - harmless);
    Lines const ran = machine::ran();
    EXPECT_FALSE(std::filesystem::exists(mark));
    auto const changes = std::count_if(ran.begin(), ran.end(), [](std::string const& line) {
        return startsWith(line, "/usr/sbin/usermod ");
    });
    EXPECT_EQ(static_cast<std::size_t>(changes), harmless);
}

TEST_F(InjectionInto, AnyModuleNameReachesNoShell)
{
    std::string modules = "Module Size\n";
    Lines expected;
    std::size_t refused = 0;
    for (std::string const& name : hostileBytes()) {
        int const byte = static_cast<unsigned char>(name[1]);
        if (std::isspace(byte))
            continue; // which ends the name
        modules += name + " 1 0\n";
        if (isPartOfSafeNames(byte))
            expected.push_back("modinfo " + name);
        else
            ++refused;
    }
    for (char const* name : {"x`touch${IFS}/tmp/pwned`", "x;touch${IFS}/tmp/pwned", "-x"}) {
        modules += std::string(name) + " 1 0\n";
        ++refused;
    }
    machine::write("/tmp/modules", modules);
    machine::fake("/usr/sbin/lsmod", "cat /tmp/modules\n");
    Outcome const outcome = mihostRun({"--json", "list", "drivers"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(Json::parse(outcome.out).size(), expected.size());
    EXPECT_EQ(linesOf(outcome.err).size(), refused);
    EXPECT_EQ(linesOf(outcome.err).back(),
              "mihost: command not run: modinfo: the name of the module '-x' begins with "
              "'-', so a command would read it as an option");
    Lines ran = machine::ran();
    ran.erase(std::remove_if(ran.begin(), ran.end(),
                             [](std::string const& line) { return line.rfind("modinfo", 0) != 0; }),
              ran.end());
    EXPECT_EQ(ran, expected);
    EXPECT_FALSE(std::filesystem::exists(mark));
}

} // namespace hostile_arguments_test
