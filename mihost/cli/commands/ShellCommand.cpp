#include "mihost/cli/shell/Shell.h"

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/Terminal.h"

#include <iostream>

namespace mihost
{

namespace
{

class ShellCommand : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_flag("--keep-going", keepGoing_,
                     "continue a script after a command that fails; the exit status is that of the "
                     "first failure");
    }

    void run(Session& session) override
    {
        session.nodes(); // loaded once, before the first line
        Shell shell(session, commandTable());
        if (terminal::canAsk())
            shell.runInteractively();
        else
            shell.runScript(std::cin, keepGoing_);
    }

private:
    bool keepGoing_ = false;
};

} // namespace

CommandRow const commandRows::shell{
    "shell",
    "run many commands on one loaded plug-in",
    newCommand<ShellCommand>,
    {
        {"mihost --sandbox shell", "type commands in a sandbox"},
        {"echo 'get os os-name' | mihost shell", "run a script"},
    },
    CommandRow::NotInShell,
};

} // namespace mihost
