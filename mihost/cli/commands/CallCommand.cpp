#include "mihost/cli/change/Clearance.h"
#include "mihost/cli/change/MembershipCheck.h"
#include "mihost/cli/change/MethodWrite.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/CatalogueText.h"
#include "mihost/cli/output/Style.h"

#include <fmt/ranges.h>

namespace mihost
{

namespace
{

class Call : public Command
{
public:
    void declare(CLI::App& app) override
    {
        method_ =
            app.add_option("METHOD", name_, "such as UserAdd; see 'mihost call UserAdd --help'")
                ->required();
        app.add_option(
            "PARAMETER", assignments_,
            "NAME=VALUE, days as YYYY-MM-DD; Password=- reads the password from a prompt or "
            "standard input");
        // When help is shown, the words given so far are known but not yet in name_.
        app.footer([this] {
            Method const* const known =
                method_->empty() ? nullptr : findMethod(method_->results().front());
            auto const lines = known ? methodLines(*known, Room()) : layOut(methodsTable(), Room());
            return withoutStyles(fmt::format("{}\n", fmt::join(lines, "\n")));
        });
    }

    void run(Session& session) override
    {
        MethodCall const call = parseCall(name_, assignments_, [&session](std::string const& name) {
            return session.askSecret(name);
        });
        IC::MutableNode& os = session.node("os");
        ChangeLock const lock = clearChange(session, "call " + name_, dangerOf(call),
                                            [&call] { checkMembership(call); });
        carryOut(session, methodWrite(session, os, call));
    }

private:
    CLI::Option* method_ = nullptr;
    std::string name_;
    std::vector<std::string> assignments_;
};

} // namespace

CommandRow const commandRows::call{
    "call",
    "run an administration method",
    newCommand<Call>,
    {
        {"mihost call UserAdd UserName=asmith ScriptPath=/bin/bash", "add an account"},
        {"mihost --sandbox call LocalGroupAdd GroupName=builders", "try adding a group"},
    },
};

} // namespace mihost
