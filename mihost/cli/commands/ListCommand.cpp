#include "mihost/cli/commands/makers.h"
#include "mihost/cli/output/NodeTable.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/Stderr.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost
{

namespace
{

std::vector<std::string> listNames()
{
    std::vector<std::string> names;
    for (NodeKind const& kind : nodeKinds())
        if (*kind.listName)
            names.emplace_back(kind.listName);
    return names;
}

class List : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("KIND", kind_, fmt::format("{}", fmt::join(listNames(), ", ")))
            ->required()
            ->check(CLI::IsMember(listNames()));
        app.add_option("--columns", columns_,
                       "properties to show, with commas between them; also "
                       "id, index, status, description")
            ->delimiter(',');
    }

    void run(Session& session) override
    {
        NodeKind const& kind = *findList(kind_);
        NodeTable const table(kind, columns_);
        std::vector<IC::MutableNode*> nodes = session.nodes();
        nodes.erase(std::remove_if(nodes.begin(), nodes.end(),
                                   [&kind](IC::MutableNode const* node) {
                                       return node->getNodeType() != kind.type;
                                   }),
                    nodes.end());
        if (session.options().json)
            session.out().json(table.json(nodes, session.secrets()));
        else
            table.write(nodes, session.secrets(), session.out());
        if (nodes.empty() && !session.options().json)
            writeStderr(
                fmt::format("mihost: nothing to list under {}; see 'mihost doctor'\n", kind_));
    }

private:
    std::string kind_;
    std::vector<std::string> columns_;
};

} // namespace

std::unique_ptr<Command> commandMakers::list()
{
    return std::make_unique<List>();
}

} // namespace mihost
