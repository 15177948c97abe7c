#include "mihost/cli/commands/Repetition.h"

#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/system/Stderr.h"

namespace mihost
{

bool waitForNextRound(Output const& out, SignalWaiter& signals, double seconds)
{
    auto const event = signals.wait({out.descriptor(), 0, 0}, seconds);
    if (event == SignalWaiter::Event::Ready)
        throw OutputClosed();
    if (event == SignalWaiter::Event::Signal && terminal::canAsk())
        writeStderr("\n"); // the terminal shows ^C
    return event == SignalWaiter::Event::Timeout;
}

} // namespace mihost
