#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/NodeTree.h"
#include "mihost/cli/plugin/Session.h"

#include <unordered_set>

namespace mihost
{

namespace
{

/** @return the node and all nodes below it; parents come before their children */
std::vector<IC::MutableNode*> branchOf(std::vector<IC::MutableNode*> const& nodes,
                                       IC::MutableNode const& top)
{
    std::unordered_set<unsigned int> inside = {top.getNodeId()};
    std::vector<IC::MutableNode*> branch;
    for (IC::MutableNode* const node : nodes)
        if (node == &top || inside.count(node->getLinkedId()) != 0) {
            inside.insert(node->getNodeId());
            branch.push_back(node);
        }
    return branch;
}

class Tree : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_, "show only this node and its descendants");
        app.add_flag("--all", all_, "show every node's properties");
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        std::vector<IC::MutableNode*> nodes = session.nodes();
        if (!address_.empty())
            nodes = branchOf(nodes, findNode(nodes, address_));
        session.out().paged([&] { writeTree(nodes, {all_, session.secrets()}, session.out()); });
    }

private:
    std::string address_;
    bool all_ = false;
};

} // namespace

CommandRow const commandRows::tree{
    "tree",
    "show the tree, one line per node",
    newCommand<Tree>,
    {
        {"mihost tree", "the whole tree"},
        {"mihost tree os --all", "the operating system with its properties"},
    },
};

} // namespace mihost
