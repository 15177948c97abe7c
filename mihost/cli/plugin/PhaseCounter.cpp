#include "mihost/cli/plugin/PhaseCounter.h"

#include "mihost/cli/log/LogLine.h"

#include <algorithm>
#include <cstdlib>
#include <fmt/format.h>
#include <iterator>
#include <string_view>

namespace mihost
{

/** The messages that count a phase's steps. */
struct PhaseSteps {
    struct Message {
        std::string_view function;
        std::string_view start;
    };

    std::string_view phase; // its function
    Message step;
    Message total; // its text continues with the number of steps; never logged without a function
    unsigned int mostSteps = 0; // 0 for any number
};

namespace
{

constexpr std::string_view moduleHeading = "buffer = Module "; // the first line of lsmod

constexpr PhaseSteps countedPhases[] = {
    {"createDriverNodes", {"getDriverInfo", "buffer = "}, {}},
    {"createUserNodes", {"UserNode", "UserNode::UserNode: entry"}, {}},
    {"createGroupNodes",
     {"GroupNode", "GroupNode::GroupNode: entry"},
     {"createGroupNodes", "groups.size() = "}},
    {"createLogEntryNodes",
     {"LogEntryNode", "LogEntryNode::LogEntryNode: entry"},
     {"getMaxLine", "buffer = "},
     mostLogEntries},
};

bool beginsWith(std::string_view text, std::string_view start)
{
    return text.substr(0, start.size()) == start;
}

bool matches(LogMessage const& message, PhaseSteps::Message const& wanted)
{
    return !wanted.function.empty() && message.function == wanted.function &&
           beginsWith(message.text, wanted.start);
}

} // namespace

void PhaseCounter::begin(Phase const& phase)
{
    auto const found =
        std::find_if(std::begin(countedPhases), std::end(countedPhases),
                     [&phase](PhaseSteps const& each) { return each.phase == phase.function; });
    phase_ = phase.name;
    steps_ = found == std::end(countedPhases) ? nullptr : found;
    done_ = 0;
    total_ = 0;
}

void PhaseCounter::end()
{
    *this = PhaseCounter();
}

bool PhaseCounter::take(LogMessage const& message)
{
    if (!steps_ || message.operation != LogMessage::Operation::Log)
        return false;
    if (matches(message, steps_->step) && !beginsWith(message.text, moduleHeading)) {
        ++done_;
        return true;
    }
    if (total_ != 0 || !matches(message, steps_->total))
        return false;
    char const* const number = message.text.c_str() + steps_->total.start.size();
    total_ = static_cast<unsigned int>(std::strtoul(number, nullptr, 10));
    if (steps_->mostSteps != 0)
        total_ = std::min(total_, steps_->mostSteps);
    return total_ != 0;
}

std::string PhaseCounter::text() const
{
    if (total_ != 0)
        return fmt::format("{} {}/{}", phase_, std::min(done_, total_), total_);
    return done_ == 0 ? phase_ : fmt::format("{} {}", phase_, done_);
}

} // namespace mihost
