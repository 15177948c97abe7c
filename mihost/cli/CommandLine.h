#ifndef MIHOST_CLI_COMMANDLINE_H
#define MIHOST_CLI_COMMANDLINE_H

#include "mihost/cli/Command.h"
#include "mihost/cli/Options.h"

namespace mihost
{

/** The arguments, taken apart. */
class CommandLine
{
public:
    /** Adds all options and commands. What the application is given then ends up here. */
    void declare(CLI::App& app);

    /**
     * Prints help or the version where they are asked for; there is no command then.
     *
     * @throws Failure (BadUsage)
     */
    void parse(int argc, char** argv);

    Options const& options() const
    {
        return options_;
    }

    /** What is to run, null where nothing is. */
    Command* command() const
    {
        return command_;
    }

private:
    Options options_;
    std::vector<std::unique_ptr<Command>> all_;
    Command* command_ = nullptr;
};

} // namespace mihost

#endif
