#include "mihost/cli/commands/makers.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/Stderr.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

class Get : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_,
                       "an id, or a name such as os or user:root; tree shows them")
            ->required();
        app.add_option("PROPERTY", names_,
                       "ids or names, which properties explains; all of them where none is given");
    }

    void run(Session& session) override
    {
        IC::MutableNode const& node = session.node(address_);
        NodeView const view = names_.empty() ? liveView(node, session.secrets())
                                             : liveView(node, names_, session.secrets());
        if (session.options().json)
            session.out().json(toJson(view));
        else if (view.properties.empty())
            writeStderr(fmt::format("mihost: node '{}' has no properties\n", address_));
        else
            writeProperties(view.properties, "", session.out());
    }

private:
    std::string address_;
    std::vector<std::string> names_;
};

} // namespace

std::unique_ptr<Command> commandMakers::get()
{
    return std::make_unique<Get>();
}

} // namespace mihost
