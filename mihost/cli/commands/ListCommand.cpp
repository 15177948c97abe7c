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
        app.add_option("--columns", columns_,
                       "show these properties, separated by commas; also "
                       "id, index, status, description")
            ->delimiter(',');
        logOptions_.declare(app);
    }

    void run(Session& session) override
    {
        NodeKind const& kind = *findList(kind_);
        bool const isLog = kind.type == IC::nodeType::logEntry;
        if (std::string const option = logOptions_.firstGiven(); !isLog && !option.empty())
            throw Failure(BadUsage, fmt::format("list {}: {} is an option of 'mihost list log'",
                                                kind_, option));
        logOptions_.check();
        if (logOptions_.follows()) {
            logOptions_.follow(session);
            return;
        }
        NodeTable const table(kind, columns_);
        std::vector<IC::MutableNode*> nodes = session.nodes();
        nodes.erase(std::remove_if(nodes.begin(), nodes.end(),
                                   [&kind](IC::MutableNode const* node) {
                                       return node->getNodeType() != kind.type;
                                   }),
                    nodes.end());
        bool const isEmpty = nodes.empty();
        if (isLog)
            nodes = logOptions_.chosen(nodes);
        if (session.options().json)
            session.out().json(table.json(nodes, session.secrets()));
        else
            table.write(nodes, session.secrets(), session.out(),
                        [this, isLog](PropertyView const& property) {
                            return isLog ? logOptions_.shownText(property) : valueText(property);
                        });
        if (isEmpty && !session.options().json)
            writeStderr(
                fmt::format("mihost: nothing to list under {}; see 'mihost doctor'\n", kind_));
    }

private:
    std::string kind_;
    std::vector<std::string> columns_;
    LogOptions logOptions_;
};

} // namespace

CommandRow const commandRows::list{
    "list",
    "show one kind of node as a table",
    newCommand<List>,
    {
        {"mihost list users", "the user accounts"},
        {"mihost list drivers --columns driver-name,driver-version",
         "two columns of the kernel modules"},
    },
};

} // namespace mihost
