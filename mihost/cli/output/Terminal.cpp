#include "mihost/cli/output/Terminal.h"

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/Stderr.h"

#include <algorithm>
#include <cerrno>
#include <fmt/format.h>
#include <langinfo.h>
#include <optional>
#include <poll.h>
#include <string_view>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

namespace mihost::terminal
{

namespace
{

constexpr unsigned int usualWidth = 80;

/** Byte by byte, so that the rest is left for the next reader. */
std::optional<std::string> readLine()
{
    std::string line;
    for (;;) {
        // poll waits, since under the thread sanitizer a waiting read delays signals.
        pollfd input{STDIN_FILENO, POLLIN, 0};
        poll(&input, 1, -1);
        char byte = 0;
        ssize_t const count = read(STDIN_FILENO, &byte, 1);
        if (count < 0 && errno == EINTR)
            continue;
        if (count <= 0)
            return line.empty() ? std::nullopt : std::optional(line);
        if (byte == '\n')
            return line;
        line += byte;
    }
}

/** Turns echo off; restores it even if a signal ends the program. */
class EchoOff
{
public:
    EchoOff()
    {
        tcgetattr(STDIN_FILENO, &before_);
        interrupts::setTerminalToRestore(&before_);
        termios silent = before_;
        silent.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        silent.c_lflag |= ECHONL;
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &silent);
    }
    ~EchoOff()
    {
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &before_);
        interrupts::setTerminalToRestore(nullptr);
    }
    EchoOff(EchoOff const&) = delete;
    EchoOff& operator=(EchoOff const&) = delete;

private:
    termios before_{};
};

} // namespace

unsigned int width(int descriptor)
{
    if (isatty(descriptor) != 1)
        return 0;
    winsize size{};
    if (ioctl(descriptor, TIOCGWINSZ, &size) == 0 && size.ws_col > 0)
        return size.ws_col;
    return usualWidth;
}

bool fits(int descriptor, std::string_view text)
{
    winsize size{};
    if (ioctl(descriptor, TIOCGWINSZ, &size) != 0 || size.ws_row == 0 || size.ws_col == 0)
        return true; // unknown
    std::size_t rows = 1;
    while (!text.empty() && rows <= size.ws_row) {
        std::size_t const end = std::min(text.find('\n'), text.size());
        std::size_t const width = displayWidth(text.substr(0, end));
        rows += width == 0 ? 1 : (width - 1) / size.ws_col + 1;
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return rows <= size.ws_row;
}

bool hasUnicode()
{
    return std::string_view(nl_langinfo(CODESET)) == "UTF-8";
}

bool canAsk()
{
    return isatty(STDIN_FILENO) == 1;
}

bool confirm(std::string const& question)
{
    writeStderr(fmt::format("{} [y/N] ", question));
    auto const answer = readLine();
    return answer && (*answer == "y" || *answer == "Y" || *answer == "yes");
}

std::string readSecret(std::string const& prompt)
{
    std::optional<std::string> secret;
    if (canAsk()) {
        EchoOff const silent;
        writeStderr(fmt::format("{}: ", prompt));
        secret = readLine();
    } else {
        secret = readLine();
    }
    if (!secret)
        throw Failure(BadUsage, fmt::format("{}: standard input is empty", prompt));
    return *secret;
}

} // namespace mihost::terminal
