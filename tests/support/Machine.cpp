#include "tests/support/Machine.h"

#include "TestPaths.h"

#include "mihost/sandbox/Sandbox.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace machine
{

namespace
{

namespace fs = std::filesystem;

char const* const shell = "/bin/sh";
char const* const notes = "/run/recorded";

void expectSandbox()
{
    if (!mihost::inSandbox())
        throw std::logic_error("not in a sandbox: nothing is changed");
}

struct Call {
    std::string program;
    std::vector<std::string> arguments;
};

std::vector<Call> recorded()
{
    std::vector<Call> found;
    std::istringstream in(read(notes));
    std::string count;
    for (Call call; std::getline(in, call.program, '\0') && std::getline(in, count, '\0');) {
        call.arguments.resize(std::stoul(count));
        for (std::string& argument : call.arguments)
            std::getline(in, argument, '\0');
        found.push_back(call);
    }
    return found;
}

std::vector<Call> recorded(std::string const& program)
{
    std::string const itself = fs::canonical(program);
    std::vector<Call> found = recorded();
    found.erase(std::remove_if(found.begin(), found.end(),
                               [&itself](Call const& call) { return call.program != itself; }),
                found.end());
    return found;
}

} // namespace

void lay(std::string const& name)
{
    // A distribution is recognised by which of these files exist.
    for (char const* release : {"/etc/release", "/etc/vmware-release", "/etc/redhat-release",
                                "/etc/SuSE-release", "/etc/UnitedLinux-release"})
        remove(release);
    mihost::layOver(MACHINES_DIR "/" + name);
}

void recordShell()
{
    record(shell);
}

void record(std::string const& program)
{
    expectSandbox();
    if (!fs::exists(notes)) {
        write(notes, "", 0666);
    }
    fs::rename(program, program + ".real");
    fs::copy_file(RECORDER_FILE, program);
}

std::vector<std::string> ran()
{
    std::vector<std::string> lines;
    for (Call const& call : recorded(shell)) {
        // sh -c LINE, with newer C libraries sh -c -- LINE; anything else is not a command line.
        auto const& arguments = call.arguments;
        if (arguments.size() < 3 || arguments[1] != "-c")
            continue;
        lines.push_back(arguments[2] == "--" && arguments.size() > 3 ? arguments[3] : arguments[2]);
    }
    return lines;
}

std::vector<std::vector<std::string>> calls(std::string const& program)
{
    std::vector<std::vector<std::string>> lists;
    for (Call const& call : recorded(program))
        lists.emplace_back(call.arguments.begin() + 1, call.arguments.end());
    return lists;
}

void forget()
{
    expectSandbox();
    fs::resize_file(notes, 0);
}

void write(std::string const& path, std::string const& text, mode_t mode)
{
    expectSandbox();
    fs::create_directories(fs::path(path).parent_path());
    fs::remove(path);
    std::ofstream file(path, std::ios::binary);
    file << text;
    file.close();
    if (!file || chmod(path.c_str(), mode) != 0)
        throw std::runtime_error("cannot write " + path);
}

void fake(std::string const& program, std::string const& script)
{
    write(program, "#!/bin/sh\n" + script, 0755);
}

void writeIdRanges()
{
    write("/etc/login.defs", "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX 60000\n");
}

void run(std::string const& line)
{
    expectSandbox();
    if (std::system(line.c_str()) != 0)
        throw std::runtime_error("failed: " + line);
}

Outcome mihostRunAsUser(std::vector<std::string> arguments, std::string const& input)
{
    expectSandbox();
    // The build may be in a directory of root only.
    for (fs::path folder = fs::path(MIHOST_FILE).parent_path(); folder != "/";
         folder = folder.parent_path())
        permissions(folder, fs::perms::group_exec | fs::perms::others_exec, fs::perm_options::add);
    arguments.insert(arguments.begin(),
                     {"/usr/bin/setpriv", "--reuid=65534", "--clear-groups", MIHOST_FILE});
    return runToEnd(arguments, input);
}

void remove(std::string const& path)
{
    expectSandbox();
    fs::remove(path);
}

std::string read(std::string const& path)
{
    std::ifstream file(path, std::ios::binary);
    if (!file)
        throw std::runtime_error("cannot read " + path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

std::vector<std::string> entry(std::string const& file, std::string const& name)
{
    std::istringstream lines(read(file));
    for (std::string line; std::getline(lines, line);) {
        if (line.rfind(name + ":", 0) != 0)
            continue;
        std::vector<std::string> fields(1);
        for (char const character : line) {
            if (character == ':')
                fields.emplace_back();
            else
                fields.back().push_back(character);
        }
        return fields;
    }
    return {};
}

} // namespace machine
