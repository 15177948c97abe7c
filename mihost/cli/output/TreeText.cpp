#include "mihost/cli/output/TreeText.h"

#include "mihost/cli/input/Address.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/output/Terminal.h"
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
    return kind && kind->headline != 0 ? storedText(node, kind->headline) : "";
}

std::string textOf(IC::MutableNode const& node)
{
    std::string const description = printable(node.getDescription());
    std::string const headline = printable(headlineOf(node));
    if (description.empty() && headline.empty())
        return "";
    return "  " + description + (headline.empty() ? "" : ": " + headline);
}

/** What leads to a node's line, and what to the lines below it. */
struct Branch {
    char const* child;
    char const* lastChild;
    char const* below;
    char const* belowLast;
};

constexpr Branch unicodeBranch = {"├─ ", "└─ ", "│  ", "   "};
constexpr Branch plainBranch = {"|- ", "`- ", "|  ", "   "};

class Drawing
{
public:
    Drawing(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out)
        : style_(style), out_(out), branch_(terminal::hasUnicode() ? unicodeBranch : plainBranch),
          room_(out.room())
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
        drawLine(node, lead);
        auto const found = children_.find(node.getNodeId());
        bool const leaf = found == children_.end();
        if (style_.properties)
            writeProperties(storedView(node, style_.secrets).properties,
                            below + (leaf ? "" : branch_.below) + "      ", out_);
        if (leaf)
            return;
        for (IC::MutableNode const* child : found->second) {
            bool const last = child == found->second.back();
            draw(*child, below + (last ? branch_.lastChild : branch_.child),
                 below + (last ? branch_.belowLast : branch_.below));
        }
    }

    void drawLine(IC::MutableNode const& node, std::string const& lead) const
    {
        Room left = room_;
        auto const take = [&left](std::string const& text) {
            std::string taken = fitted(text, left);
            left.columns -= displayWidth(taken);
            return taken;
        };
        std::string const start = take(lead);
        std::string const address = take(printable(addressOf(node)));
        std::string const id = take(fmt::format(" #{}", node.getNodeId()));
        std::string const text = take(textOf(node));
        out_.line(start + out_.bold(address) + out_.faint(id) + text);
    }

    TreeStyle style_;
    Output& out_;
    Branch branch_;
    Room room_;
    std::vector<IC::MutableNode const*> tops_;
    std::unordered_map<unsigned int, std::vector<IC::MutableNode const*>> children_;
};

} // namespace

void writeTree(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out)
{
    Drawing(nodes, style, out).draw();
}

} // namespace mihost
