#include "mihost/cli/plugin/Phases.h"

#include <algorithm>
#include <string>
#include <utility>

namespace mihost
{

std::vector<Phase> const& phases()
{
    static std::vector<Phase> const rows = {
        {"createOsSwNodes", "management interface"},
        {"createRootNode", "root"},
        {"createComputerNodes", "computer"},
        {"createOsNodes", "operating system"},
        {"createDriverNodes", "drivers"},
        {"createUserNodes", "users"},
        {"createGroupNodes", "groups"},
        {"createLogNodes", "log"},
        {"createLogEntryNodes", "log entries"},
    };
    return rows;
}

PhaseSink::PhaseSink(std::vector<PhaseListener*> listeners) : listeners_(std::move(listeners)) {}

void PhaseSink::write(LogMessage const& message)
{
    if (message.operation != LogMessage::Operation::Log)
        return;
    auto const phase = std::find_if(phases().begin(), phases().end(), [&message](Phase const& row) {
        return row.function == std::string_view(message.function);
    });
    if (phase == phases().end())
        return;
    bool const begins = message.text == std::string(phase->function) + ": entry";
    bool const ends = message.text == std::string(phase->function) + ": exit";
    for (PhaseListener* listener : listeners_) {
        if (begins)
            listener->phaseBegins(*phase);
        else if (ends)
            listener->phaseEnds(*phase);
    }
}

SinkGroup::~SinkGroup()
{
    if (!sinks_.empty())
        setLogSink(nullptr);
}

void SinkGroup::add(LogSink& sink)
{
    sinks_.push_back(&sink);
    setLogSink(this);
}

void SinkGroup::remove(LogSink const& sink)
{
    sinks_.erase(std::remove(sinks_.begin(), sinks_.end(), &sink), sinks_.end());
    if (sinks_.empty())
        setLogSink(nullptr);
}

void SinkGroup::write(LogMessage const& message)
{
    for (LogSink* sink : sinks_)
        sink->write(message);
}

} // namespace mihost
