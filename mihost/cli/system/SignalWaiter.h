#ifndef MIHOST_CLI_SYSTEM_SIGNALWAITER_H
#define MIHOST_CLI_SYSTEM_SIGNALWAITER_H

#include <csignal>
#include <poll.h>
#include <utility>
#include <vector>

namespace mihost
{

/**
 * While it exists, SIGINT and the other given signals do nothing and arrive only in wait, so that
 * none is lost between checking for it and waiting for it.
 */
class SignalWaiter
{
public:
    explicit SignalWaiter(std::vector<int> const& others = {});
    ~SignalWaiter();
    SignalWaiter(SignalWaiter const&) = delete;
    SignalWaiter& operator=(SignalWaiter const&) = delete;

    enum class Event { Ready, Timeout, Signal };

    /**
     * @param file     the descriptor to poll; also ready on errors
     * @param seconds  how long; negative for ever
     */
    Event wait(pollfd file, double seconds);

    /** @return the signal that ended the last wait */
    int signal() const
    {
        return signal_;
    }

private:
    sigset_t before_;
    std::vector<std::pair<int, struct sigaction>> actionsBefore_;
    int signal_ = 0;
};

} // namespace mihost

#endif
