#include "mihost/cli/output/TreeLayout.h"

#include "mihost/cli/output/ColumnPrinter.h"
#include "mihost/cli/output/DisplayWidth.h"

#include <algorithm>

namespace mihost
{

namespace
{

constexpr std::size_t branchWidth = 2; // of each level

/** A branch where it is drawn. */
struct DrawnBranch {
    Branch const* branch;
    std::size_t depth;
    std::string sign;  // before the name
    std::string below; // before the branch's further lines
    bool hasChildren;
};

/**
 * Puts each branch after its parent and draws the lines between them. libsmartcols can do that too,
 * but its versions draw the further lines of a branch differently.
 */
class TreeDrawing
{
public:
    TreeDrawing(std::vector<Branch> const& branches, bool hasUnicode)
        : branches_(branches), hasUnicode_(hasUnicode), children_(branches.size())
    {
        for (std::size_t at = 0; at < branches.size(); ++at)
            if (branches[at].parent != at)
                children_[branches[at].parent].push_back(at);
        for (std::size_t at = 0; at < branches.size(); ++at)
            if (branches[at].parent == at)
                draw(at, 0, "", "");
    }

    std::vector<DrawnBranch> const& drawn() const
    {
        return drawn_;
    }

    char const* vertical() const
    {
        return hasUnicode_ ? "│ " : "| ";
    }

private:
    void draw(std::size_t at, std::size_t depth, std::string const& sign, std::string const& below)
    {
        drawn_.push_back({&branches_[at], depth, sign, below, !children_[at].empty()});
        for (std::size_t const child : children_[at])
            if (child == children_[at].back())
                draw(child, depth + 1, below + (hasUnicode_ ? "└─" : "`-"), below + "  ");
            else
                draw(child, depth + 1, below + (hasUnicode_ ? "├─" : "|-"), below + vertical());
    }

    std::vector<Branch> const& branches_;
    bool hasUnicode_;
    std::vector<std::vector<std::size_t>> children_;
    std::vector<DrawnBranch> drawn_;
};

/** The text of a branch within its width, with its details below. */
std::vector<std::string> branchText(Branch const& branch, Room const& room)
{
    std::vector<std::string> lines = wrapped(branch.text, room.columns);
    if (!branch.details.rows.empty())
        for (std::string const& line : layOut(branch.details, room))
            lines.push_back(line);
    return lines;
}

/** @return name and text of a branch in one column, for lines too narrow for two */
std::string wholeBranch(DrawnBranch const& drawn, Room const& room)
{
    Branch const& branch = *drawn.branch;
    std::string const start =
        branch.text.empty() ? branch.name : branch.name + columnGap + branch.text;
    std::vector<std::string> lines = wrapped(start, std::max(room.columns, leastText));
    if (!branch.details.rows.empty())
        for (std::string const& line : layOut(branch.details, room.indented(branchWidth)))
            lines.push_back(std::string(branchWidth, ' ') + line);
    for (std::size_t at = 0; at < lines.size(); ++at)
        lines[at].insert(0, at == 0 ? drawn.sign : drawn.below);
    return joined(lines);
}

} // namespace

std::vector<std::string> layOut(std::vector<Branch> const& branches, Room const& room)
{
    TreeDrawing const tree(branches, room.hasUnicode);
    std::size_t names = 0;
    for (DrawnBranch const& drawn : tree.drawn())
        names = std::max(names, branchWidth * drawn.depth + displayWidth(drawn.branch->name));
    bool const areBeside = room.columns >= names + gapWidth + leastText;

    ColumnPrinter printer(false);
    printer.addColumn("");
    if (areBeside)
        printer.addColumn("");
    for (DrawnBranch const& drawn : tree.drawn()) {
        if (!areBeside) {
            printer.addRow({wholeBranch(drawn, room.indented(branchWidth * drawn.depth))});
            continue;
        }
        std::vector<std::string> const text =
            branchText(*drawn.branch, room.indented(names + gapWidth));
        std::vector<std::string> signs = {drawn.sign + drawn.branch->name};
        // libsmartcols would end the cell at an empty line.
        if (std::string const below = drawn.below + (drawn.hasChildren ? tree.vertical() : "");
            !below.empty())
            signs.resize(text.size(), below);
        printer.addRow({joined(signs), joined(text)});
    }
    return printer.lines();
}

} // namespace mihost
