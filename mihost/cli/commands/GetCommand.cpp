#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/NodeJson.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/Stderr.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

/** The format value prints the properties' values alone; CSV has more columns. */
Table rowsOf(NodeView const& view, Format format)
{
    Selection selection;
    if (format == Format::BareValues)
        selection.columns = {"value"};
    return propertyTable(view.properties).selected(selection);
}

class Get : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_,
                       "an id, or a name such as os or user:root; see 'mihost tree'")
            ->required();
        app.add_option("PROPERTY", names_, "ids or names, see 'mihost properties'; all by default");
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        IC::MutableNode const& node = session.node(address_);
        NodeView const view = names_.empty() ? liveView(node, session.secrets())
                                             : liveView(node, names_, session.secrets());
        Output& out = session.out();
        if (out.takesDocuments())
            out.json(toJson(view));
        else if (out.takesRows())
            out.table(rowsOf(view, session.options().format));
        else if (view.properties.empty())
            warn(fmt::format("node '{}' has no properties", address_));
        else
            writeProperties(view.properties, "", out);
    }

private:
    std::string address_;
    std::vector<std::string> names_;
};

} // namespace

CommandRow const commandRows::get{
    "get",
    "read properties of a node",
    newCommand<Get>,
    {
        {"mihost get os physical-memory-free", "the memory that is free now"},
        {"mihost get user:root", "all properties of an account"},
    },
};

} // namespace mihost
