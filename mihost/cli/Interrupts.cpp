#include "mihost/cli/Interrupts.h"

#include "mihost/cli/PrivateDirectory.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstring>
#include <fcntl.h>
#include <iterator>
#include <unistd.h>
#include <utility>

namespace mihost::interrupts
{

namespace
{

constexpr int endingSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGQUIT};
constexpr int terminalSignals[] = {SIGINT, SIGQUIT, SIGHUP};

// Read by the handler, so nothing but plain data; what is pointed to belongs to others.
char const* volatile folder = nullptr;
termios const* volatile terminal = nullptr;
char const* volatile lastWords = nullptr;
volatile std::sig_atomic_t noted = 0; // the signal
int screen = STDERR_FILENO;

void removeFolder(char const* path)
{
    int const opened = open(path, O_PATH | O_DIRECTORY | O_CLOEXEC);
    if (opened < 0)
        return;
    for (char const* const file : privateDirectoryFiles)
        unlinkat(opened, file, 0);
    close(opened);
    rmdir(path);
}

void endBy(int signal)
{
    struct sigaction standard {
    };
    standard.sa_handler = SIG_DFL;
    sigaction(signal, &standard, nullptr);
    raise(signal); // takes effect when the handler returns
}

void handle(int signal)
{
    int const before = errno;
    if (char const* const words = lastWords)
        if (write(screen, words, std::strlen(words)) < 0)
            errno = 0; // nobody is there to be told
    if (termios const* const settings = terminal)
        tcsetattr(STDIN_FILENO, TCSANOW, settings);
    if (char const* const path = folder)
        removeFolder(path);
    endBy(signal);
    errno = before;
}

void note(int signal)
{
    noted = signal;
}

void ignore(int) {}

void setHandler(int signal, void (*handler)(int), int flags)
{
    struct sigaction action {
    };
    action.sa_handler = handler;
    action.sa_flags = flags;
    for (int const other : endingSignals)
        sigaddset(&action.sa_mask, other);
    sigaction(signal, &action, nullptr);
}

bool isIgnored(int signal)
{
    struct sigaction action {
    };
    sigaction(signal, nullptr, &action);
    return action.sa_handler == SIG_IGN;
}

} // namespace

void install()
{
    // Standard error goes elsewhere for the moment in which a command is started.
    screen = fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 3);
    for (int const signal : endingSignals)
        if (!isIgnored(signal)) // as nohup leaves it
            setHandler(signal, handle, SA_RESTART);
    // A reader that goes early or a file that grows too long is an error of writing, not the end.
    // Not SIG_IGN, which the commands would inherit.
    for (int const signal : {SIGPIPE, SIGXFSZ})
        setHandler(signal, ignore, SA_RESTART);
}

void setFolderToRemove(char const* path)
{
    folder = path;
}

void setTerminalToRestore(termios const* settings)
{
    terminal = settings;
}

void setLastWords(char const* text)
{
    lastWords = text;
}

Held::Held()
{
    sigset_t set;
    sigemptyset(&set);
    for (int const signal : endingSignals)
        sigaddset(&set, signal);
    sigprocmask(SIG_BLOCK, &set, &before_);
    struct sigaction ignored {
    };
    ignored.sa_handler = SIG_IGN;
    // One that comes while it is blocked waits, ignored or not: to unblock it is to get it.
    for (std::size_t at = 0; at < std::size(terminalSignals); ++at)
        sigaction(terminalSignals[at], &ignored, &actionsBefore_[at]);
}

Held::~Held()
{
    for (std::size_t at = 0; at < std::size(terminalSignals); ++at)
        sigaction(terminalSignals[at], &actionsBefore_[at], nullptr);
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

Noted::Noted(std::vector<int> const& others)
{
    std::vector<int> signals = others;
    signals.push_back(SIGINT);
    sigset_t set;
    sigemptyset(&set);
    for (int const signal : signals)
        sigaddset(&set, signal);
    sigprocmask(SIG_BLOCK, &set, &before_);
    noted = 0;
    for (int const signal : signals) {
        struct sigaction before {
        };
        sigaction(signal, nullptr, &before);
        actionsBefore_.emplace_back(signal, before);
        if (before.sa_handler != SIG_IGN)
            setHandler(signal, note, 0);
    }
}

Noted::~Noted()
{
    for (auto const& [signal, before] : actionsBefore_)
        sigaction(signal, &before, nullptr);
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

Noted::Event Noted::wait(pollfd file, double seconds)
{
    double whole = 0;
    double const rest = std::modf(std::max(seconds, 0.0), &whole);
    timespec const time{static_cast<time_t>(whole), static_cast<long>(rest * 1e9)};
    int const ready = ppoll(&file, 1, seconds < 0 ? nullptr : &time, &before_);
    signal_ = std::exchange(noted, 0);
    if (signal_ != 0)
        return Event::Signal;
    return ready > 0 ? Event::Ready : Event::Timeout;
}

} // namespace mihost::interrupts
