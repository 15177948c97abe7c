#ifndef MIHOST_CLI_SHELL_SHELL_H
#define MIHOST_CLI_SHELL_SHELL_H

#include "mihost/cli/input/Command.h"
#include "mihost/cli/plugin/Session.h"

#include <istream>
#include <string>

namespace mihost
{

/** Runs commands line by line on the session's plug-in. */
class Shell
{
public:
    /** @param table  the commands that lines may name; must outlive this */
    Shell(Session& session, CommandTable const& table);

    /** Runs the lines that the user types, until the end of input. */
    void runInteractively();

    /**
     * Runs a script. Failed lines are reported with their number.
     *
     * @param keepGoing  whether the script continues after a failed line
     * @throws Failure of the first failed line, unless it continues
     */
    void runScript(std::istream& script, bool keepGoing);

private:
    /** @return whether the line was the last one */
    bool runLine(std::string const& line);
    void tellAsJson(Failure const& failure);
    std::vector<std::string> candidatesFor(std::string const& line);

    Session& session_;
    CommandTable const& table_;
    Options const options_; // what each line starts from
};

} // namespace mihost

#endif
