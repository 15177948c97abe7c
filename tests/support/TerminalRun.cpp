#include "tests/support/TerminalRun.h"

#include <array>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <poll.h>
#include <pty.h>
#include <stdexcept>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <termios.h>
#include <unistd.h>

TerminalRun::TerminalRun(std::vector<std::string> arguments, unsigned short columns,
                         std::string const& program)
{
    arguments.insert(arguments.begin(), program);
    std::vector<char*> list;
    for (std::string& argument : arguments)
        list.push_back(argument.data());
    list.push_back(nullptr);
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0)
        throw std::runtime_error("no pipe can be had");
    descendants_ = ends[0];
    winsize size{24, columns, 0, 0};
    child_ = forkpty(&master_, nullptr, nullptr, &size);
    if (child_ == 0) {
        std::signal(SIGINT, SIG_DFL);     // a script's background job ignores it
        fcntl(ends[1], F_SETFD, 0);       // it stays open and is inherited
        setenv("MIHOST_PAGER", "cat", 0); // a pager would wait for keys
        execv(list[0], list.data());
        _exit(127);
    }
    close(ends[1]);
    if (child_ < 0)
        throw std::runtime_error("no terminal can be had");
}

TerminalRun::~TerminalRun()
{
    if (child_ > 0) {
        kill(child_, SIGKILL);
        waitpid(child_, nullptr, 0);
    }
    close(master_);
    close(descendants_);
}

void TerminalRun::type(std::string const& text) const
{
    if (write(master_, text.data(), text.size()) != static_cast<ssize_t>(text.size()))
        throw std::runtime_error("cannot type");
}

bool TerminalRun::readMore(Clock::time_point deadline)
{
    auto const left =
        std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
    pollfd terminal{master_, POLLIN, 0};
    if (left.count() <= 0 || poll(&terminal, 1, static_cast<int>(left.count())) == 0)
        throw std::runtime_error("nothing came in time after: " + output_.substr(seen_));
    std::array<char, 4096> block{};
    ssize_t const count = read(master_, block.data(), block.size());
    if (count > 0)
        output_.append(block.data(), static_cast<std::size_t>(count));
    return count > 0; // the terminal's other end closes with an error
}

std::string TerminalRun::waitFor(std::string const& text, std::chrono::milliseconds limit)
{
    Clock::time_point const deadline = Clock::now() + limit;
    for (;;) {
        std::size_t const found = output_.find(text, seen_);
        if (found != std::string::npos) {
            std::string const read = output_.substr(seen_, found + text.size() - seen_);
            seen_ = found + text.size();
            return read;
        }
        if (!readMore(deadline))
            throw std::runtime_error("ended without '" + text + "': " + output_.substr(seen_));
    }
}

void TerminalRun::resize(unsigned short columns) const
{
    winsize const size{24, columns, 0, 0};
    ioctl(master_, TIOCSWINSZ, &size); // the kernel sends SIGWINCH
}

void TerminalRun::dropNothingWithCtrlC() const
{
    termios settings{};
    tcgetattr(master_, &settings);
    settings.c_lflag |= NOFLSH;
    tcsetattr(master_, TCSANOW, &settings);
}

bool TerminalRun::showsInput() const
{
    termios settings{};
    tcgetattr(master_, &settings);
    return (settings.c_lflag & ECHO) != 0;
}

void TerminalRun::waitForStop() const
{
    int status = 0;
    if (waitpid(child_, &status, WUNTRACED) != child_ || !WIFSTOPPED(status))
        throw std::runtime_error("ended rather than stopped");
}

void TerminalRun::waitForDescendants() const
{
    char byte = 0;
    while (read(descendants_, &byte, 1) > 0) {
    }
}

int TerminalRun::end(std::chrono::milliseconds limit)
{
    Clock::time_point const deadline = Clock::now() + limit;
    while (readMore(deadline)) {
    }
    int status = 0;
    waitpid(child_, &status, 0);
    child_ = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

Outcome atTerminal(std::vector<std::string> const& arguments, unsigned short columns)
{
    TerminalRun run(arguments, columns);
    int const code = run.end();
    return {code, run.output(), ""};
}
