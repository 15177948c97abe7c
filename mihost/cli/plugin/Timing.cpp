#include "mihost/cli/plugin/Timing.h"

#include "mihost/cli/plugin/CommandTap.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

double seconds(Timing::Clock::duration time)
{
    return std::chrono::duration<double>(time).count();
}

Timing::Row sumOf(std::vector<Timing::Row> const& rows)
{
    Timing::Row sum{"total", {}, 0};
    for (Timing::Row const& row : rows) {
        sum.time += row.time;
        sum.commands += row.commands;
    }
    return sum;
}

std::string line(Timing::Row const& row)
{
    return fmt::format("{:<20} {:>10.3f} ms {:>6} command{}\n", row.phase, 1000 * seconds(row.time),
                       row.commands, row.commands == 1 ? "" : "s");
}

} // namespace

void Timing::begin(std::string const& phase)
{
    commandsBefore_ = commandTap::count();
    rows_.push_back({phase, {}, 0});
    began_ = Clock::now();
}

void Timing::end()
{
    rows_.back().time = Clock::now() - began_;
    rows_.back().commands = commandTap::count() - commandsBefore_;
}

void Timing::phaseBegins(Phase const& phase)
{
    begin(phase.name);
}

void Timing::phaseEnds(Phase const&)
{
    end();
}

std::string timingText(std::vector<Timing::Row> const& rows)
{
    std::string text;
    for (Timing::Row const& row : rows)
        text += line(row);
    return text + line(sumOf(rows));
}

Json toJson(std::vector<Timing::Row> const& rows)
{
    Json list = Json::array();
    for (Timing::Row const& row : rows)
        list.push_back(
            {{"phase", row.phase}, {"seconds", seconds(row.time)}, {"commands", row.commands}});
    return {{"timing", list}};
}

} // namespace mihost
