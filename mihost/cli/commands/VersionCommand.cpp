#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/plugin/Session.h"

namespace mihost
{

namespace
{

class Version : public Command
{
public:
    void declare(CLI::App&) override {}

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        Plugin const& plugin = session.plugin();
        Table table({{"mihost"}, {"contract"}, {"plugin"}, {"soname"}});
        table.add({MIHOST_VERSION, MIHOST_CONTRACT, plugin.path(), plugin.soname()});
        session.out().record(table);
    }
};

} // namespace

CommandRow const commandRows::version{
    "version",
    "show the versions of the program, the contract and the plug-in",
    newCommand<Version>,
    {
        {"mihost version", "the versions and the plug-in's file"},
        {"mihost --json version", "the same as JSON"},
    },
};

} // namespace mihost
