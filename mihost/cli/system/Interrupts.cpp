#include "mihost/cli/system/Interrupts.h"

#include "mihost/cli/system/EndingSignals.h"
#include "mihost/cli/system/PrivateDirectory.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <unistd.h>

namespace mihost::interrupts
{

namespace
{

// Read by the signal handler, so only plain data, not owned here.
char const* volatile folder = nullptr;
termios const* volatile terminal = nullptr;
char const* volatile lastWords = nullptr;
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
            errno = 0; // the reader is gone
    if (termios const* const settings = terminal)
        tcsetattr(STDIN_FILENO, TCSANOW, settings);
    if (char const* const path = folder)
        removeFolder(path);
    endBy(signal);
    errno = before;
}

void ignore(int) {}

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
    // Standard error is redirected while a command starts.
    screen = fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 3);
    for (int const signal : endingSignals)
        if (!isIgnored(signal)) // as nohup leaves it
            setHandler(signal, handle, SA_RESTART);
    // A closed pipe or a file size limit is a write error, not a reason to die. Not SIG_IGN, which
    // commands would inherit.
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

} // namespace mihost::interrupts
