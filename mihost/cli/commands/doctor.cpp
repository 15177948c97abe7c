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

Json documentOf(std::vector<Need> const& needs)
{
    Json list = Json::array();
    for (Need const& need : needs)
        list.push_back({{"need", need.what},
                        {"ok", !need.problem},
                        {"problem", need.problem ? toJson(*need.problem) : Json(nullptr)},
                        {"cost", need.cost},
                        {"debian", need.debian},
                        {"red-hat", need.redHat}});
    return list;
}

void write(Need const& need, Output& out)
{
    if (!need.problem) {
        out.line(fmt::format("ok       {}", need.what));
        return;
    }
    out.line(fmt::format("missing  {}: {}", need.what, printable(*need.problem)));
    out.line(fmt::format("           costs    {}", need.cost));
    out.line(fmt::format("           Debian   {}", need.debian));
    out.line(fmt::format("           Red Hat  {}", need.redHat));
}

class Doctor : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        std::vector<Need> const needs = diagnose();
        Output& out = session.out();
        auto const missing = std::count_if(
            needs.begin(), needs.end(), [](Need const& need) { return need.problem.has_value(); });
        if (session.options().json) {
            out.json(documentOf(needs));
        } else {
            for (Need const& need : needs)
                write(need, out);
            out.line(fmt::format("{} of {} missing", missing, needs.size()));
        }
        if (missing != 0)
            session.endWith(PluginRefused);
    }
};

} // namespace

std::unique_ptr<Command> commandMakers::doctor()
{
    return std::make_unique<Doctor>();
}

} // namespace mihost
