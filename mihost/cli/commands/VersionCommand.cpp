#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/plugin/Session.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

class Version : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        Plugin const& plugin = session.plugin();
        if (session.options().json) {
            session.out().json({{"mihost", MIHOST_VERSION},
                                {"contract", MIHOST_CONTRACT},
                                {"plugin", toJson(plugin.path())},
                                {"soname", toJson(plugin.soname())}});
            return;
        }
        session.out().line(fmt::format("mihost    {}", MIHOST_VERSION));
        session.out().line(fmt::format("contract  {}", MIHOST_CONTRACT));
        session.out().line(fmt::format("plug-in   {} ({})", plugin.soname(), plugin.path()));
    }
};

} // namespace

CommandRow const commandRows::version{
    "version",
    "show the versions of program, contract and plug-in",
    newCommand<Version>,
    {
        {"mihost version", "the versions and the plug-in's file"},
        {"mihost --json version", "the same as JSON"},
    },
};

} // namespace mihost
