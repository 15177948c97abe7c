#ifndef MIHOST_CLI_INTERRUPTS_H
#define MIHOST_CLI_INTERRUPTS_H

#include <csignal>
#include <poll.h>
#include <termios.h>
#include <utility>
#include <vector>

/**
 * What happens on Ctrl-C and its kin. By default the program tidies up and ends as the signal would
 * have ended it.
 */
namespace mihost::interrupts
{

/**
 * Takes over SIGINT, SIGTERM, SIGHUP and SIGQUIT, and keeps SIGPIPE and SIGXFSZ from ending the
 * program.
 */
void install();

/** @param path  a folder to remove when a signal ends the program; null for none */
void setFolderToRemove(char const* path);

/** @param settings  what the terminal goes back to when a signal ends the program; null for none */
void setTerminalToRestore(termios const* settings);

/** @param text  written to standard error when a signal ends the program; null for none */
void setLastWords(char const* text);

/**
 * Holds signals back for as long as it lives: a change to the system that has begun is finished. A
 * terminal sends its signals to the commands as well, and a shell undoes a mask, so commands
 * started meanwhile ignore them.
 */
class Held
{
public:
    Held();
    ~Held();
    Held(Held const&) = delete;
    Held& operator=(Held const&) = delete;

private:
    sigset_t before_;
    struct sigaction actionsBefore_[3]{};
};

/**
 * For as long as it lives, SIGINT and the other signals named do nothing and come only in wait: so
 * none slips in between asking whether it came and waiting for it.
 */
class Noted
{
public:
    explicit Noted(std::vector<int> const& others = {});
    ~Noted();
    Noted(Noted const&) = delete;
    Noted& operator=(Noted const&) = delete;

    enum class Event { Ready, Timeout, Signal };

    /**
     * @param file     what poll is to look at; ready also where it has something unasked to tell
     * @param seconds  how long; negative for ever
     */
    Event wait(pollfd file, double seconds);

    /** The one that the last wait ended by. */
    int signal() const
    {
        return signal_;
    }

private:
    sigset_t before_;
    std::vector<std::pair<int, struct sigaction>> actionsBefore_;
    int signal_ = 0;
};

} // namespace mihost::interrupts

#endif
