#include "mihost/cli/check/LogRules.h"

#include "host/VXLogger.h"
#include "mihost/cli/check/Subject.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>
#include <string_view>
#include <tuple>

namespace mihost::checks
{

namespace
{

constexpr int levels[] = {VXLog::level::progress, VXLog::level::power, VXLog::level::error};

constexpr std::string_view categories[] = {
    "Veltrix.IC.MI.OsSwMI",           "Veltrix.IC.MI.OsSwMI.MyProcess",
    "Veltrix.IC.MI.OsSwMI.OsInfo",    "Veltrix.IC.MI.OsSwMI.UserInfo",
    "Veltrix.IC.MI.OsSwMI.GroupInfo", "Veltrix.IC.MI.OsSwMI.DriverInfo",
    "Veltrix.IC.MI.OsSwMI.LogInfo",
};

constexpr std::string_view entryMark = ": entry";
constexpr std::string_view exitMark = ": exit";

template <class Known, class Value> bool isAmong(Known const& known, Value const& value)
{
    return std::find(std::begin(known), std::end(known), value) != std::end(known);
}

bool isLog(LoggedCall const& call)
{
    return call.operation == LogMessage::Operation::Log;
}

auto argumentsOf(LoggedCall const& call)
{
    return std::tie(call.function, call.file, call.line, call.category, call.level, call.hasExtra,
                    call.first, call.second, call.text);
}

/** What comes before the ending, or nothing if the text ends otherwise. */
std::optional<std::string> nameBefore(std::string_view ending, std::string const& text)
{
    if (text.size() <= ending.size() ||
        text.compare(text.size() - ending.size(), ending.size(), ending) != 0)
        return std::nullopt;
    return text.substr(0, text.size() - ending.size());
}

/** Whether an entry of this name may have no exit. */
bool mayLackExit(std::string const& name)
{
    if (name == "PropertyType::CreateUser")
        return true;
    std::size_t const colons = name.find("::");
    if (colons == std::string::npos)
        return false;
    std::string const type = name.substr(0, colons);
    std::string const function = name.substr(colons + 2);
    return function == type || function == '~' + type;
}

/** The functions that were entered and not left yet, the innermost last. */
class OpenScopes
{
public:
    void enter(std::string const& name)
    {
        names_.push_back(name);
    }

    void leave(std::string const& name)
    {
        auto const found = std::find(names_.rbegin(), names_.rend(), name);
        if (found == names_.rend()) {
            findings_.push_back(fmt::format("{}: exit without an entry", name));
            return;
        }
        dropAfter(static_cast<std::size_t>(std::distance(found, names_.rend())), name);
        names_.pop_back();
    }

    Findings finish()
    {
        dropAfter(0, "");
        return findings_;
    }

private:
    void dropAfter(std::size_t depth, std::string const& outer)
    {
        for (std::size_t at = depth; at < names_.size(); ++at)
            if (!mayLackExit(names_[at]))
                findings_.push_back(outer.empty()
                                        ? fmt::format("{}: entry without an exit", names_[at])
                                        : fmt::format("{}: entry without an exit before that of {}",
                                                      names_[at], outer));
        names_.resize(depth);
    }

    std::vector<std::string> names_;
    Findings findings_;
};

template <Findings (*rule)(LoggedCalls const&)> Verdict onLog(Subject& subject)
{
    return {rule(subject.log())};
}

} // namespace

Findings wrongRepeats(LoggedCalls const& calls)
{
    Findings findings;
    for (std::size_t at = 0; at < calls.size(); ++at) {
        LoggedCall const& call = calls[at];
        if (!isLog(call)) {
            findings.push_back(fmt::format("traced but not logged before: {}", call.text));
            continue;
        }
        bool const traced = at + 1 < calls.size() && !isLog(calls[at + 1]);
        if (!traced)
            findings.push_back(fmt::format("logged but not traced after: {}", call.text));
        else if (argumentsOf(call) != argumentsOf(calls[++at]))
            findings.push_back(
                fmt::format("logged and traced with different arguments: {}", call.text));
    }
    if (calls.empty())
        findings.emplace_back("nothing was logged");
    return findings;
}

Findings wrongArguments(LoggedCalls const& calls)
{
    Findings findings;
    for (LoggedCall const& call : calls) {
        if (call.function.empty() || call.file.empty() || call.line <= 0)
            findings.push_back(fmt::format("no function, unit or line: {}", call.text));
        if (call.hasExtra || call.first != 0 || call.second != 0)
            findings.push_back(fmt::format("not null, 0 and 0 before the message: {}", call.text));
    }
    return findings;
}

Findings wrongLevels(LoggedCalls const& calls)
{
    Findings findings;
    for (LoggedCall const& call : calls)
        if (!isAmong(levels, call.level))
            findings.push_back(fmt::format("level {}: {}", call.level, call.text));
    return findings;
}

Findings wrongCategories(LoggedCalls const& calls)
{
    Findings findings;
    for (LoggedCall const& call : calls)
        if (!isAmong(categories, call.category))
            findings.push_back(fmt::format("category '{}': {}", call.category, call.text));
    return findings;
}

Findings wrongNesting(LoggedCalls const& calls)
{
    OpenScopes open;
    for (LoggedCall const& call : calls) {
        if (!isLog(call))
            continue;
        if (auto const name = nameBefore(entryMark, call.text))
            open.enter(*name);
        else if (auto const left = nameBefore(exitMark, call.text))
            open.leave(*left);
    }
    return open.finish();
}

std::vector<Check> logChecks()
{
    return {
        {"log-repeats", "each message is logged and then traced, with the same arguments",
         onLog<wrongRepeats>},
        {"log-arguments", "each message names its function, unit and line", onLog<wrongArguments>},
        {"log-levels", "levels are 3000, 4000 or 6000", onLog<wrongLevels>},
        {"log-categories", "categories are those of the contract", onLog<wrongCategories>},
        {"log-nesting", "entries and exits nest", onLog<wrongNesting>},
    };
}

} // namespace mihost::checks
