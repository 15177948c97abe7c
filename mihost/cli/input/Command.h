#ifndef MIHOST_CLI_INPUT_COMMAND_H
#define MIHOST_CLI_INPUT_COMMAND_H

#include <CLI/App.hpp>
#include <memory>
#include <vector>

namespace mihost
{

class Session;

/** One of the program's commands: it declares what it takes, is filled in, and runs. */
class Command
{
public:
    virtual ~Command() = default;

    /** Adds the command's own arguments and options, bound to its members. */
    virtual void declare(CLI::App& app) = 0;

    /** @throws Failure */
    virtual void run(Session& session) = 0;
};

struct CommandRow {
    char const* name;
    char const* summary;
    std::unique_ptr<Command> (*make)();
    bool notInShell = false;
    bool alwaysInSandbox = false;
};

/** Every command, in the order of the help text. */
using CommandTable = std::vector<CommandRow>;

} // namespace mihost

#endif
