#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/doctor/Diagnosis.h"
#include "mihost/cli/output/Style.h"
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

Cell cellOrNull(std::string const& text)
{
    return text.empty() ? Cell(nullptr, "") : Cell(text);
}

Cell truth(bool value)
{
    return {value, value ? "true" : "false"};
}

Table tableOf(std::vector<Need> const& needs)
{
    Table table({{"need"},
                 {"ok"},
                 {"fixable"},
                 {"problem"},
                 {"effect"},
                 {"debian"},
                 {"red-hat"},
                 {"opensuse"},
                 {"no-fix"}});
    for (Need const& need : needs)
        table.add({need.what, truth(isMet(need)),
                   isMet(need) ? Cell(nullptr, "") : truth(!isBeyondFixing(need)),
                   isMet(need) ? Cell(nullptr, "") : Cell(*need.problem), need.effect,
                   cellOrNull(need.fix.debian), cellOrNull(need.fix.redHat),
                   cellOrNull(need.fix.opensuse), cellOrNull(need.noFix)});
    return table;
}

/** How a need that is not met is written. */
void writeUnmet(Need const& need, Output& out)
{
    struct Row {
        char const* heading;
        std::string text;
    };
    bool const isBeyond = isBeyondFixing(need);
    std::string const state =
        isBeyond ? styled(Style::Yellow, "no fix ") : styled(Style::Red, "missing");
    out.line(fmt::format("{}  {}: {}", state, need.what, printable(*need.problem)));
    Fix const fix = isBeyond ? Fix{} : need.fix;
    for (Row const& row :
         {Row{"effect", need.effect}, Row{"no fix", isBeyond ? need.noFix : ""},
          Row{"Debian", fix.debian}, Row{"Red Hat", fix.redHat}, Row{"openSUSE", fix.opensuse}})
        if (!row.text.empty())
            out.line(fmt::format("           {:<8} {}", row.heading, row.text));
}

/** What can be fixed comes last, next to the prompt. */
void write(std::vector<Need> needs, Output& out)
{
    auto const unmet = std::stable_partition(needs.begin(), needs.end(), isMet);
    auto const fixable = std::stable_partition(unmet, needs.end(), isBeyondFixing);
    for (auto need = needs.begin(); need != unmet; ++need)
        out.line(fmt::format("{}       {}", styled(Style::Green, "ok"), need->what));
    for (auto need = unmet; need != needs.end(); ++need)
        writeUnmet(*need, out);
    out.line(fmt::format("{} of {} missing, {} cannot be fixed here", needs.end() - unmet,
                         needs.size(), fixable - unmet));
}

class Doctor : public Command
{
public:
    void declare(CLI::App&) override {}

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        std::vector<Need> const needs = diagnose();
        Output& out = session.out();
        if (out.takesDocuments() || out.takesRows())
            out.table(tableOf(needs));
        else
            write(needs, out);
        bool const isFixable = std::any_of(needs.begin(), needs.end(), [](Need const& need) {
            return !isMet(need) && !isBeyondFixing(need);
        });
        if (isFixable)
            session.endWith(Failed);
    }
};

} // namespace

CommandRow const commandRows::doctor{
    "doctor",
    "report what this machine lacks for a full tree",
    newCommand<Doctor>,
    {
        {"mihost doctor", "what is missing, and how to fix it"},
        {"mihost --json doctor", "the same as JSON"},
    },
};

} // namespace mihost
