#include "mihost/cli/system/SignalBlock.h"

#include "mihost/cli/system/EndingSignals.h"

#include <iterator>

namespace mihost
{

namespace
{

constexpr int terminalSignals[] = {SIGINT, SIGQUIT, SIGHUP};

} // namespace

SignalBlock::SignalBlock()
{
    sigset_t const set = endingSignalSet();
    sigprocmask(SIG_BLOCK, &set, &before_);
    struct sigaction ignored {
    };
    ignored.sa_handler = SIG_IGN;
    // A blocked signal stays pending, ignored or not, and would arrive when it is unblocked.
    for (std::size_t at = 0; at < std::size(terminalSignals); ++at)
        sigaction(terminalSignals[at], &ignored, &actionsBefore_[at]);
}

SignalBlock::~SignalBlock()
{
    for (std::size_t at = 0; at < std::size(terminalSignals); ++at)
        sigaction(terminalSignals[at], &actionsBefore_[at], nullptr);
    sigprocmask(SIG_SETMASK, &before_, nullptr);
}

} // namespace mihost
