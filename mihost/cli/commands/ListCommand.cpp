#include "host/Properties.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/LogOptions.h"
#include "mihost/cli/output/NodeTable.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/Stderr.h"

#include <algorithm>
#include <fmt/format.h>

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
        choices_.restrict(app.add_option("KIND", kind_, "what to list"), listNames())->required();
        selection_.declare(app);
        logOptions_.declare(app);
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        NodeKind const& kind = *findList(kind_);
        bool const isLog = kind.type == IC::nodeType::logEntry;
        if (std::string const option = logOptions_.firstGiven(); !isLog && !option.empty())
            throw Failure(BadUsage,
                          fmt::format("list {}: {} is an option of the log (use 'mihost list log')",
                                      kind_, option));
        logOptions_.check(session.options());
        if (logOptions_.follows()) {
            logOptions_.follow(session);
            return;
        }
        std::vector<IC::MutableNode*> nodes = session.nodes();
        nodes.erase(std::remove_if(nodes.begin(), nodes.end(),
                                   [&kind](IC::MutableNode const* node) {
                                       return node->getNodeType() != kind.type;
                                   }),
                    nodes.end());
        bool const isEmpty = nodes.empty();
        if (isLog)
            nodes = logOptions_.chosen(nodes);
        auto const shownText = [this, isLog](PropertyView const& property) {
            return isLog ? logOptions_.shownText(property) : valueText(property);
        };
        Output& out = session.out();
        out.paged([&] {
            writeNodes(kind, nodes, {session.secrets(), shownText}, selection_, out);
        });
        if (isEmpty && !out.takesDocuments())
            warn(fmt::format("nothing to list under {} (see 'mihost doctor')", kind_));
    }

private:
    std::string kind_;
    Selection selection_;
    LogOptions logOptions_;
};

} // namespace

CommandRow const commandRows::list{
    "list",
    "show one kind of node as a table",
    newCommand<List>,
    {
        {"mihost list users", "the user accounts"},
        {"mihost list users --where login-shell=/bin/bash --columns user-name -o value",
         "the names of those with this shell"},
    },
};

} // namespace mihost
