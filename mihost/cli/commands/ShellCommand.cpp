#include "mihost/cli/shell/Shell.h"

#include "mihost/cli/commands/makers.h"
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
                     "let a script go on behind a command that fails; the first failure is what "
                     "the exit code tells of");
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

std::unique_ptr<Command> commandMakers::shell()
{
    return std::make_unique<ShellCommand>();
}

} // namespace mihost
