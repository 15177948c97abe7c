#include "mihost/cli/commands/LogOptions.h"

#include "host/Properties.h"
#include "mihost/cli/commands/Repetition.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Moment.h"
#include "mihost/cli/input/Range.h"
#include "mihost/cli/log/LogFile.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/runtime/Text.h"

#include <ctime>
#include <fmt/format.h>
#include <system_error>

namespace mihost
{

namespace
{

constexpr unsigned int usualFollowed = 10; // lines that --follow begins with
constexpr unsigned int mostLines = 1000000000;
constexpr double interval = 0.5; // seconds between two looks at the log

std::string objectionToMoment(std::string const& text)
{
    return parseMoment(text, std::time(nullptr)) ? ""
                                                 : fmt::format("'{}' is not {}", text, momentForm);
}

std::tm localTime()
{
    std::time_t const now = std::time(nullptr);
    std::tm fields{};
    localtime_r(&now, &fields);
    return fields;
}

LogLine lineOf(IC::MutableNode const& entry)
{
    auto const stored = entry.getProperties();
    LogLine line;
    if (auto const time = stored.find(IC::property::creationTime); time != stored.end())
        line.time = static_cast<long>(time->second.getNumber());
    if (auto const message = stored.find(IC::property::message); message != stored.end())
        line.message = withoutAsterisks(static_cast<std::string>(message->second));
    return line;
}

} // namespace

void LogOptions::declare(CLI::App& app)
{
    app.add_option("-n,--lines", count_,
                   fmt::format("log: show at most N entries; without --follow there are {}",
                               mostLogEntries))
        ->check(wholeBetween(0, mostLines))
        ->type_name("N");
    app.add_option("--since", since_, "log: show entries from this time on")
        ->type_name("TIME")
        ->check(objectionToMoment);
    app.add_option("--until", until_, "log: show entries up to this time")
        ->type_name("TIME")
        ->check(objectionToMoment);
    app.add_option("--grep", pattern_,
                   "log: show entries whose message matches this extended regular expression")
        ->type_name("PATTERN");
    app.add_flag("--follow", follow_, "log: show new lines as they arrive");
    app.add_flag("--no-hostname", noHostName_, "log: omit the name of the host");
}

std::string LogOptions::firstGiven() const
{
    struct Row {
        char const* option;
        bool isGiven;
    };
    for (Row const& row : {Row{"--lines", count_.has_value()}, Row{"--since", !since_.empty()},
                           Row{"--until", !until_.empty()}, Row{"--grep", !pattern_.empty()},
                           Row{"--follow", follow_}, Row{"--no-hostname", noHostName_}})
        if (row.isGiven)
            return row.option;
    return "";
}

void LogOptions::check(Options const& options)
{
    isFull_ = options.full;
    if (follow_ && isRows(options.format))
        throw Failure(
            BadUsage,
            fmt::format("list log: -o {} is not supported with --follow (use table, json, jsonl or "
                        "yaml)",
                        nameOf(options.format)));
    if (follow_ && !until_.empty())
        throw Failure(BadUsage, "list log: --follow and --until cannot be combined");
}

LogFilter LogOptions::filter() const
{
    long const now = std::time(nullptr);
    LogFilter filter;
    if (!since_.empty())
        filter.setSince(parseMoment(since_, now).value());
    if (!until_.empty())
        filter.setUntil(parseMoment(until_, now).value());
    if (!pattern_.empty())
        filter.setPattern(pattern_);
    return filter;
}

std::vector<IC::MutableNode*> LogOptions::chosen(std::vector<IC::MutableNode*> const& entries) const
{
    LogFilter const wanted = filter();
    std::vector<IC::MutableNode*> shown;
    for (IC::MutableNode* const entry : entries)
        if (wanted.shows(lineOf(*entry)))
            shown.push_back(entry);
    if (count_ && shown.size() > *count_)
        shown.resize(*count_);
    return shown;
}

std::string LogOptions::shownText(PropertyView const& property) const
{
    std::string const text = valueText(property);
    return property.id == IC::property::message ? shownMessage(text) : text;
}

std::string LogOptions::shownMessage(std::string const& message) const
{
    if (isFull_)
        return message;
    std::string const text = withoutAsterisks(message);
    return noHostName_ ? withoutHostName(text) : text;
}

void LogOptions::print(Session& session, LogLine const& line) const
{
    std::string const message = shownMessage("*" + line.message + "*");
    if (session.out().takesDocuments())
        session.out().json(
            {{"time", line.time ? Json(*line.time) : Json(nullptr)}, {"message", toJson(message)}});
    else
        session.out().line(fmt::format("{:<19}  {}", line.time ? timeText(*line.time) : "-",
                                       message.empty() ? "-" : printable(message)));
}

void LogOptions::follow(Session& session) const
{
    LogFilter const wanted = filter();
    auto const printThose = [&](std::vector<std::string> const& lines) {
        std::tm const today = localTime();
        for (std::string const& each : lines)
            if (LogLine const line = logLineOf(each, today); wanted.shows(line))
                print(session, line);
        session.out().flush();
    };
    try {
        SignalWaiter signals;
        LogFile log(systemLog);
        printThose(log.newestLines(count_.value_or(usualFollowed)));
        while (waitForNextRound(session.out(), signals, interval))
            printThose(log.newLines());
    } catch (std::system_error const& error) {
        throw Failure(Failed, fmt::format("list log: {} (see 'mihost doctor')", error.what()));
    }
}

} // namespace mihost
