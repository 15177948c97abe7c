#ifndef TESTS_SUPPORT_TERMINALRUN_H
#define TESTS_SUPPORT_TERMINALRUN_H

#include "TestPaths.h"
#include "tests/support/Program.h"

#include <chrono>
#include <string>
#include <sys/types.h>
#include <vector>

/**
 * Runs mihost, or another program, at a terminal. Standard output, standard error and what the
 * terminal echoes come as one text, and nothing is paged unless MIHOST_PAGER is set.
 */
class TerminalRun
{
public:
    static constexpr std::chrono::milliseconds usualLimit = std::chrono::minutes(2);

    explicit TerminalRun(std::vector<std::string> arguments, unsigned short columns = 80,
                         std::string const& program = MIHOST_FILE);
    ~TerminalRun();
    TerminalRun(TerminalRun const&) = delete;
    TerminalRun& operator=(TerminalRun const&) = delete;

    /** Types the text; "\x03" is Ctrl-C, "\x04" Ctrl-D, "\t" asks for completion. */
    void type(std::string const& text) const;

    /**
     * Reads until the text appears after what was read before.
     *
     * @param limit  how long at most: long enough for a slow machine, and a failing test ends
     * @return what was read, up to the end of the text
     * @throws std::runtime_error if the program ends before, or the time is over
     */
    std::string waitFor(std::string const& text, std::chrono::milliseconds limit = usualLimit);

    void resize(unsigned short columns) const;

    /** Keeps the kernel from dropping output that is not read yet when Ctrl-C is typed. */
    void dropNothingWithCtrlC() const;

    /** @return whether the terminal echoes what is typed */
    bool showsInput() const;

    /**
     * Reads to the end.
     *
     * @return the exit code, or 128 and the number of the signal that ended it
     * @throws std::runtime_error if the program does not end in time
     */
    int end(std::chrono::milliseconds limit = usualLimit);

    /** Waits until the program is stopped, as Ctrl-Z does. */
    void waitForStop() const;

    /** Waits until no process that the program started is left. */
    void waitForDescendants() const;

    /** @return everything that was read so far */
    std::string const& output() const
    {
        return output_;
    }

    pid_t child() const
    {
        return child_;
    }

private:
    using Clock = std::chrono::steady_clock;

    bool readMore(Clock::time_point deadline);

    pid_t child_ = -1;
    int master_ = -1;
    int descendants_ = -1; // a pipe that every descendant has open
    std::string output_;
    std::size_t seen_ = 0;
};

/** Runs mihost at a terminal to its end. @return what the terminal shows, as standard output */
Outcome atTerminal(std::vector<std::string> const& arguments, unsigned short columns = 80);

#endif
