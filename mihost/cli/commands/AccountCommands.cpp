// One account or one group as its administrator reads it.

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/GroupView.h"
#include "mihost/cli/commands/UserView.h"

namespace mihost
{

namespace
{

class AccountCommand : public Command
{
public:
    using Show = void(Session& session, std::string const& name);

    explicit AccountCommand(Show* show) : show_(show) {}

    void declare(CLI::App& app) override
    {
        app.add_option("NAME", name_, "its name")->required();
    }

    void run(Session& session) override
    {
        show_(session, name_);
    }

private:
    Show* show_;
    std::string name_;
};

} // namespace

CommandRow const commandRows::user{
    "user",
    "show one local account",
    []() -> std::unique_ptr<Command> { return std::make_unique<AccountCommand>(showUser); },
    {
        {"mihost user jdoe", "ids, groups, state and password ageing"},
        {"mihost user root --json", "the same for a program"},
    },
};

CommandRow const commandRows::group{
    "group",
    "show one local group",
    []() -> std::unique_ptr<Command> { return std::make_unique<AccountCommand>(showGroup); },
    {
        {"mihost group crew", "its id and members"},
        {"mihost group crew --json", "the same for a program"},
    },
};

} // namespace mihost
