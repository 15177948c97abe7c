#include "tests/support/Program.h"

#include "TestPaths.h"
#include "tests/support/MessageForm.h"

#include <array>
#include <cstdio>
#include <memory>
#include <ostream>
#include <stdexcept>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

struct CloseFile {
    void operator()(std::FILE* file) const
    {
        std::fclose(file);
    }
};

// Files rather than pipes, so that neither side waits for the other.
using File = std::unique_ptr<std::FILE, CloseFile>;

File fileOf(std::string const& text)
{
    File file(std::tmpfile());
    if (!file || std::fwrite(text.data(), 1, text.size(), file.get()) != text.size())
        throw std::runtime_error("cannot write a temporary file");
    std::rewind(file.get());
    return file;
}

std::string textOf(File const& file)
{
    std::rewind(file.get());
    std::string text;
    std::array<char, 4096> block{};
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), file.get()))
        text.append(block.data(), length);
    return text;
}

} // namespace

bool operator==(Outcome const& one, Outcome const& other)
{
    return one.code == other.code && one.out == other.out && one.err == other.err;
}

std::ostream& operator<<(std::ostream& out, Outcome const& outcome)
{
    return out << "exit code " << outcome.code << "\n--- standard output\n"
               << outcome.out << "--- standard error\n"
               << outcome.err;
}

Outcome printed(std::string const& out)
{
    return {0, out, ""};
}

Outcome failed(int code, std::string const& message)
{
    return {code, "", "mihost: " + message + "\n"};
}

Outcome runToEnd(std::vector<std::string> const& arguments, std::string const& input)
{
    File const in = fileOf(input);
    File const out = fileOf("");
    File const err = fileOf("");
    std::vector<char*> list;
    for (std::string const& argument : arguments)
        list.push_back(const_cast<char*>(argument.c_str()));
    list.push_back(nullptr);

    pid_t const child = fork();
    if (child == 0) {
        dup2(fileno(in.get()), STDIN_FILENO);
        dup2(fileno(out.get()), STDOUT_FILENO);
        dup2(fileno(err.get()), STDERR_FILENO);
        execv(list[0], list.data());
        _exit(127);
    }
    int status = 0;
    if (child < 0 || waitpid(child, &status, 0) != child)
        throw std::runtime_error("cannot run " + arguments.at(0));
    int const code = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    Outcome const outcome{code, textOf(out), textOf(err)};
    if (auto const flaw = flawOfMessages(outcome.err))
        throw std::runtime_error(*flaw);
    return outcome;
}

Outcome mihostRun(std::vector<std::string> arguments, std::string const& input)
{
    arguments.insert(arguments.begin(), MIHOST_FILE);
    return runToEnd(arguments, input);
}

Outcome bashRun(std::string const& line, std::string const& input)
{
    return runToEnd({"/bin/bash", "-c", "mihost=$1; " + line, "bash", MIHOST_FILE}, input);
}
