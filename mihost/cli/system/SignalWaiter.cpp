#include "mihost/cli/system/SignalWaiter.h"

#include "mihost/cli/system/EndingSignals.h"

#include <algorithm>
#include <cmath>

namespace mihost
{

namespace
{

volatile std::sig_atomic_t noted = 0; // the signal

void note(int signal)
{
    noted = signal;
}

} // namespace

SignalWaiter::SignalWaiter(std::vector<int> const& others)
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

SignalWaiter::~SignalWaiter()
{
    for (auto const& [signal, before] : actionsBefore_)
        sigaction(signal, &before, nullptr);
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

SignalWaiter::Event SignalWaiter::wait(pollfd file, double seconds)
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

} // namespace mihost
