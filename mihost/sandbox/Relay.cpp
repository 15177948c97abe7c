#include "mihost/sandbox/Relay.h"

#include <initializer_list>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace mihost
{

namespace
{

sigset_t relayed()
{
    sigset_t set;
    sigemptyset(&set);
    for (int const signal : {SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGUSR1, SIGUSR2, SIGCHLD})
        sigaddset(&set, signal);
    return set;
}

} // namespace

HeldSignals::HeldSignals()
{
    sigset_t const set = relayed();
    sigprocmask(SIG_BLOCK, &set, &before_);
}

HeldSignals::~HeldSignals()
{
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

int relayTo(pid_t child)
{
    sigset_t const set = relayed();
    for (;;) {
        siginfo_t info{};
        int const signal = sigwaitinfo(&set, &info);
        if (signal == SIGCHLD) {
            // One signal may report several children.
            int status = 0;
            for (pid_t ended = 0; (ended = waitpid(-1, &status, WNOHANG)) > 0;)
                if (ended == child)
                    return status;
        } else if (signal > 0 && info.si_code != SI_KERNEL) {
            // The terminal has sent its signals to the child, too.
            kill(child, signal);
        }
    }
}

void endLike(int waitStatus)
{
    if (WIFEXITED(waitStatus))
        _exit(WEXITSTATUS(waitStatus));
    int const signal = WTERMSIG(waitStatus);
    rlimit const noCore{0, 0};
    setrlimit(RLIMIT_CORE, &noCore);
    struct sigaction standard {
    };
    standard.sa_handler = SIG_DFL;
    sigaction(signal, &standard, nullptr);
    sigset_t set;
    sigemptyset(&set);
    sigaddset(&set, signal);
    kill(getpid(), signal);
    sigprocmask(SIG_UNBLOCK, &set, nullptr);
    _exit(128 + signal); // not reached
}

} // namespace mihost
