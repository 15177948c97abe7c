#include "mihost/cli/Diagnosis.h"
#include "mihost/cli/Session.h"
#include "mihost/cli/commands/makers.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

bool isMet(Need const& need)
{
    return !need.problem;
}

Json documentOf(std::vector<Need> const& needs)
{
    Json list = Json::array();
    for (Need const& need : needs)
        list.push_back({{"need", need.what},
                        {"ok", isMet(need)},
                        {"problem", isMet(need) ? Json(nullptr) : toJson(*need.problem)},
                        {"cost", need.cost},
                        {"debian", need.debian},
                        {"red-hat", need.redHat}});
    return list;
}

/** What is missing comes last, where a person looks first. */
void write(std::vector<Need> needs, Output& out)
{
    auto const missing = std::stable_partition(needs.begin(), needs.end(), isMet);
    for (auto need = needs.begin(); need != missing; ++need)
        out.line(fmt::format("ok       {}", need->what));
    for (auto need = missing; need != needs.end(); ++need) {
        out.line(
            fmt::format("{}  {}: {}", out.bold("missing"), need->what, printable(*need->problem)));
        out.line(fmt::format("           costs    {}", need->cost));
        out.line(fmt::format("           Debian   {}", need->debian));
        out.line(fmt::format("           Red Hat  {}", need->redHat));
    }
    out.line(fmt::format("{} of {} missing", needs.end() - missing, needs.size()));
}

class Doctor : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        std::vector<Need> const needs = diagnose();
        if (session.options().json)
            session.out().json(documentOf(needs));
        else
            write(needs, session.out());
        if (!std::all_of(needs.begin(), needs.end(), isMet))
            session.endWith(PluginRefused);
    }
};

} // namespace

std::unique_ptr<Command> commandMakers::doctor()
{
    return std::make_unique<Doctor>();
}

} // namespace mihost
