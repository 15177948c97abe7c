#ifndef MIHOST_CLI_PLUGIN_COMMANDTAP_H
#define MIHOST_CLI_PLUGIN_COMMANDTAP_H

#include <cstdio>
#include <string>
#include <vector>

/**
 * The program's own popen and pclose interpose libc's (see popen.cpp), so commands that the plug-in
 * starts are started here. They run unchanged, but without standard input, so that none reads input
 * meant for this program, and with a separate standard error.
 *
 * The process has one such state, and one thread at a time may use it.
 */
namespace mihost::commandTap
{

/** A command line that was run, the beginning of its standard output (see BoundedText), its end. */
struct RunCommand {
    std::string line;
    std::string output;
    int status; // as from wait; 0 while the plug-in has its stream open
};

/** The functions that run the commands; at first those of libc. */
struct Runner {
    using Open = std::FILE*(char const* line, char const* mode);
    using Close = int(std::FILE* stream);

    Open* open;
    Close* close;
};

void setRunner(Runner const& runner);

/** Decides whether a command line may run. If not, popen returns null. */
using Guard = bool(char const* line);

/** @param guard  called for each command line of the plug-in; null for none */
void setGuard(Guard* guard);

/** How many commands were started so far. */
unsigned int count();

/**
 * Records every command, and its output as the plug-in reads it. Output that the plug-in does not
 * read is read when it closes the stream, so each command runs to its end.
 */
class Recording
{
public:
    Recording();
    ~Recording();
    Recording(Recording const&) = delete;
    Recording& operator=(Recording const&) = delete;

    std::vector<RunCommand> commands() const;
};

/** @return the beginning of what commands wrote to standard error since the last call */
std::string takeStandardError();

/**
 * Runs a command line of the program's own.
 *
 * @return the beginning of what it prints; empty if it cannot start
 */
std::string outputOf(std::string const& line);

/** The entry points for popen and pclose. */
std::FILE* open(char const* line, char const* mode);
int close(std::FILE* stream);

} // namespace mihost::commandTap

#endif
