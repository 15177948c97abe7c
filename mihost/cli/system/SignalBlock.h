#ifndef MIHOST_CLI_SYSTEM_SIGNALBLOCK_H
#define MIHOST_CLI_SYSTEM_SIGNALBLOCK_H

#include <csignal>

namespace mihost
{

/**
 * Holds signals back while it exists, so that a change to the system that has begun is finished. A
 * terminal sends its signals to the commands, too, and a shell resets the mask, so commands started
 * meanwhile ignore them.
 */
class SignalBlock
{
public:
    SignalBlock();
    ~SignalBlock();
    SignalBlock(SignalBlock const&) = delete;
    SignalBlock& operator=(SignalBlock const&) = delete;

private:
    sigset_t before_;
    struct sigaction actionsBefore_[3]{};
};

} // namespace mihost

#endif
