#include "mihost/cli/plugin/Progress.h"

#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/Stderr.h"

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <fmt/format.h>
#include <fstream>
#include <limits>

namespace mihost
{

namespace
{

constexpr char clearLine[] = "\r\x1b[K";
constexpr unsigned int mostLogEntries = 50;
constexpr unsigned int closely = 200; // beyond that many steps only every so many are shown

unsigned int logEntries()
{
    std::ifstream file("/var/log/messages");
    unsigned int count = 0;
    while (count < mostLogEntries &&
           file.ignore(std::numeric_limits<std::streamsize>::max(), '\n') && !file.eof())
        ++count;
    return count;
}

/** The lines that lsmod prints below its heading. */
unsigned int drivers()
{
    std::string const listing = commandTap::outputOf("lsmod");
    auto const lines = std::count(listing.begin(), listing.end(), '\n');
    return lines > 0 ? static_cast<unsigned int>(lines - 1) : 0;
}

/** How many steps a phase has, where that can be told beforehand. */
unsigned int stepsOf(Phase const& phase)
{
    if (std::strcmp(phase.function, "createDriverNodes") == 0)
        return drivers();
    if (std::strcmp(phase.function, "createLogEntryNodes") == 0)
        return logEntries();
    return 0;
}

} // namespace

Progress::Progress()
{
    commandTap::setListener(this);
    interrupts::setLastWords(clearLine);
}

Progress::~Progress()
{
    interrupts::setLastWords(nullptr);
    commandTap::setListener(nullptr);
    writeStderr(clearLine);
}

void Progress::phaseBegins(Phase const& phase)
{
    phase_ = phase.name;
    done_ = 0;
    total_ = stepsOf(phase);
    show();
}

void Progress::phaseEnds(Phase const&)
{
    phase_.clear();
}

void Progress::write(LogMessage const& message)
{
    // The node classes announce their constructors.
    static constexpr char const* announcements[] = {"UserNode", "GroupNode", "LogEntryNode"};
    if (message.operation == LogMessage::Operation::Log &&
        std::any_of(
            std::begin(announcements), std::end(announcements),
            [&message](char const* name) { return std::strcmp(message.function, name) == 0; }))
        step();
}

void Progress::commandStarts(char const* line)
{
    if (std::strncmp(line, "modinfo ", 8) == 0)
        step();
}

void Progress::step()
{
    if (phase_.empty())
        return;
    ++done_;
    if (done_ < closely || done_ % closely == 0)
        show();
}

void Progress::show() const
{
    std::string count;
    if (total_ != 0)
        count = fmt::format(" {}/{}", std::min(done_, total_), total_);
    else if (done_ != 0)
        count = fmt::format(" {}", done_);
    writeStderr(fmt::format("{}starting: {}{}", clearLine, phase_, count));
}

} // namespace mihost
