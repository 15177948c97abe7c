#include "mihost/cli/plugin/Progress.h"

#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/Stderr.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr char clearLine[] = "\r\x1b[K";
constexpr unsigned int closely = 200; // with more steps, not every one is shown

} // namespace

Progress::Progress()
{
    interrupts::setLastWords(clearLine);
}

Progress::~Progress()
{
    interrupts::setLastWords(nullptr);
    writeStderr(clearLine);
}

void Progress::phaseBegins(Phase const& phase)
{
    counter_.begin(phase);
    show();
}

void Progress::phaseEnds(Phase const&)
{
    counter_.end();
}

void Progress::write(LogMessage const& message)
{
    if (counter_.take(message) && (counter_.done() < closely || counter_.done() % closely == 0))
        show();
}

void Progress::show() const
{
    writeStderr(fmt::format("{}starting: {}", clearLine, counter_.text()));
}

} // namespace mihost
