#include "mihost/cli/Interrupts.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <unistd.h>

namespace mihost::interrupts
{

namespace
{

constexpr int endingSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGQUIT};

// Read by the handler, so nothing but plain data; what is pointed to belongs to others.
char const* volatile folder = nullptr;
termios const* volatile terminal = nullptr;
char const* volatile lastWords = nullptr;
volatile std::sig_atomic_t noting = 0;
volatile std::sig_atomic_t noted = 0;

/** The one file that the plug-in makes where it stands. */
void removeFolder(char const* path)
{
    int const opened = open(path, O_PATH | O_DIRECTORY | O_CLOEXEC);
    if (opened < 0)
        return;
    unlinkat(opened, "usrandpwd", 0);
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
    if (signal == SIGINT && noting != 0) {
        noted = 1;
    } else {
        if (char const* const words = lastWords)
            if (write(STDERR_FILENO, words, std::strlen(words)) < 0)
                errno = 0; // nobody is there to be told
        if (termios const* const settings = terminal)
            tcsetattr(STDIN_FILENO, TCSANOW, settings);
        if (char const* const path = folder)
            removeFolder(path);
        endBy(signal);
    }
    errno = before;
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
    for (int const signal : endingSignals)
        if (!isIgnored(signal)) // as nohup leaves it
            setHandler(signal, handle, SA_RESTART);
    // A reader that goes early is an error of writing, not the end. Not SIG_IGN, which the commands
    // would inherit.
    setHandler(SIGPIPE, ignore, SA_RESTART);
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
}

Held::~Held()
{
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

Noted::Noted()
{
    noted = 0;
    noting = 1;
    if (!isIgnored(SIGINT))
        setHandler(SIGINT, handle, 0); // waits and reads end early
}

Noted::~Noted()
{
    if (!isIgnored(SIGINT))
        setHandler(SIGINT, handle, SA_RESTART);
    noting = 0;
}

bool Noted::came()
{
    return noted != 0;
}

void Noted::forget()
{
    noted = 0;
}

} // namespace mihost::interrupts
