#ifndef MIHOST_CLI_INPUT_COMMAND_H
#define MIHOST_CLI_INPUT_COMMAND_H

#include "mihost/cli/input/Choices.h"

#include <CLI/App.hpp>
#include <memory>
#include <vector>

namespace mihost
{

class Session;

/** One of the program's commands: it declares its arguments, receives their values, and runs. */
class Command
{
public:
    virtual ~Command() = default;

    /** Adds the command's own arguments and options, bound to its members. */
    virtual void declare(CLI::App& app) = 0;

    /** Whether the results can also be printed as rows, so in every format. */
    virtual bool hasRows() const
    {
        return false;
    }

    /** @throws Failure */
    virtual void run(Session& session) = 0;

    ChoiceTable const& choices() const
    {
        return choices_;
    }

protected:
    ChoiceTable choices_; // of the options that declare adds
};

/** A command line as the help shows it. */
struct Example {
    char const* line; // a line for a shell
    char const* meaning;
};

struct CommandRow {
    enum Traits : unsigned {
        Plain = 0,
        NotInShell = 1,   // not among the commands of the shell
        AlwaysSandbox = 2 // always runs in a sandbox
    };

    char const* name;
    char const* summary;
    std::unique_ptr<Command> (*make)();
    Example examples[2];
    unsigned traits = Plain;

    bool has(Traits trait) const
    {
        return (traits & trait) != 0;
    }
};

/** For CommandRow::make. */
template <class C> std::unique_ptr<Command> newCommand()
{
    return std::make_unique<C>();
}

/** Every command, in the order of the help text. */
using CommandTable = std::vector<CommandRow const*>;

} // namespace mihost

#endif
