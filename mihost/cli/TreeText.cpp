#include "mihost/cli/TreeText.h"

#include "mihost/cli/Address.h"
#include "mihost/cli/PropertyText.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>
#include <unordered_map>

namespace mihost
{

namespace
{

/** What says most about a node beside its description; empty where nothing does. */
std::string headlineOf(IC::MutableNode const& node)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    if (!kind || kind->headline == 0)
        return "";
    auto const properties = node.getProperties();
    auto const found = properties.find(kind->headline);
    return found == properties.end() ? "" : static_cast<std::string>(found->second);
}

std::string lineOf(IC::MutableNode const& node)
{
    std::string const headline = headlineOf(node);
    std::string const description = node.getDescription();
    return printable(fmt::format("{} #{}  {}{}{}", addressOf(node), node.getNodeId(), description,
                                 headline.empty() ? "" : ": ", headline));
}

class Drawing
{
public:
    Drawing(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out)
        : style_(style), out_(out)
    {
        std::unordered_map<unsigned int, bool> present;
        for (IC::MutableNode const* node : nodes)
            present[node->getNodeId()] = true;
        for (IC::MutableNode const* node : nodes)
            if (present.count(node->getLinkedId()) != 0)
                children_[node->getLinkedId()].push_back(node);
            else
                tops_.push_back(node);
    }

    void draw() const
    {
        for (IC::MutableNode const* top : tops_)
            draw(*top, "", "");
    }

private:
    void draw(IC::MutableNode const& node, std::string const& lead, std::string const& below) const
    {
        out_.line(lead + lineOf(node));
        auto const found = children_.find(node.getNodeId());
        bool const leaf = found == children_.end();
        if (style_.properties)
            writeProperties(storedView(node, style_.secrets).properties,
                            below + (leaf ? "      " : "│     "), out_);
        if (leaf)
            return;
        for (IC::MutableNode const* child : found->second) {
            bool const last = child == found->second.back();
            draw(*child, below + (last ? "└─ " : "├─ "), below + (last ? "   " : "│  "));
        }
    }

    TreeStyle style_;
    Output& out_;
    std::vector<IC::MutableNode const*> tops_;
    std::unordered_map<unsigned int, std::vector<IC::MutableNode const*>> children_;
};

} // namespace

void writeTree(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out)
{
    Drawing(nodes, style, out).draw();
}

} // namespace mihost
