#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/doctor/Diagnosis.h"
#include "mihost/cli/plugin/Session.h"
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

bool isBeyondFixing(Need const& need)
{
    return !isMet(need) && !need.noFix.empty();
}

Json orNull(std::string const& text)
{
    return text.empty() ? Json(nullptr) : toJson(text);
}

Json documentOf(std::vector<Need> const& needs)
{
    Json list = Json::array();
    for (Need const& need : needs)
        list.push_back({{"need", need.what},
                        {"ok", isMet(need)},
                        {"fixable", isMet(need) ? Json(nullptr) : Json(!isBeyondFixing(need))},
                        {"problem", isMet(need) ? Json(nullptr) : toJson(*need.problem)},
                        {"effect", need.effect},
                        {"debian", orNull(need.debian)},
                        {"red-hat", orNull(need.redHat)},
                        {"no-fix", orNull(need.noFix)}});
    return list;
}

/** How a need that is not met is written. */
void writeUnmet(Need const& need, Output& out)
{
    struct Row {
        char const* heading;
        std::string text;
    };
    bool const isBeyond = isBeyondFixing(need);
    out.line(fmt::format("{}  {}: {}", out.bold(isBeyond ? "no fix " : "missing"), need.what,
                         printable(*need.problem)));
    for (Row const& row :
         {Row{"effect", need.effect}, Row{"no fix", isBeyond ? need.noFix : ""},
          Row{"Debian", isBeyond ? "" : need.debian}, Row{"Red Hat", isBeyond ? "" : need.redHat}})
        if (!row.text.empty())
            out.line(fmt::format("           {:<8} {}", row.heading, row.text));
}

/** What can be fixed comes last, where a person looks first. */
void write(std::vector<Need> needs, Output& out)
{
    auto const unmet = std::stable_partition(needs.begin(), needs.end(), isMet);
    auto const fixable = std::stable_partition(unmet, needs.end(), isBeyondFixing);
    for (auto need = needs.begin(); need != unmet; ++need)
        out.line(fmt::format("ok       {}", need->what));
    for (auto need = unmet; need != needs.end(); ++need)
        writeUnmet(*need, out);
    out.line(fmt::format("{} of {} missing, {} cannot be fixed here", needs.end() - unmet,
                         needs.size(), fixable - unmet));
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
        bool const isFixable = std::any_of(needs.begin(), needs.end(), [](Need const& need) {
            return !isMet(need) && !isBeyondFixing(need);
        });
        if (isFixable)
            session.endWith(PluginRefused);
    }
};

} // namespace

CommandRow const commandRows::doctor{
    "doctor",
    "report what this machine lacks for a full tree",
    newCommand<Doctor>,
    {
        {"mihost doctor", "what is missing, and how to install it"},
        {"mihost --json doctor", "the same as JSON"},
    },
};

} // namespace mihost
