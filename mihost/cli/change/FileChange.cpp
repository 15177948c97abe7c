#include "mihost/cli/change/FileChange.h"

#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <string_view>
#include <unordered_map>

namespace mihost
{

namespace
{

bool differs(FileChange::Attribute const& attribute)
{
    return attribute.before != attribute.after;
}

Json valueOf(std::string const& text)
{
    return text.empty() ? Json() : Json(text);
}

Json attributeToJson(FileChange::Attribute const& attribute)
{
    return {{"before", valueOf(attribute.before)}, {"after", valueOf(attribute.after)}};
}

/** Such as "mode 0640 -> 0600"; only the later one if the file is new. */
std::string textOf(char const* name, FileChange::Attribute const& attribute)
{
    if (attribute.before.empty())
        return fmt::format("{} {}", name, attribute.after);
    return fmt::format("{} {} -> {}", name, attribute.before, attribute.after);
}

std::string countOf(std::vector<std::string> const& lines, char const* what)
{
    return fmt::format("{} line{} {}", lines.size(), lines.size() == 1 ? "" : "s", what);
}

/** Such as " (directory, mode 0700, owner 1000:1000)"; empty if there is nothing to say. */
std::string remark(FileChange const& change)
{
    std::vector<std::string> remarks;
    if (change.kind != "file")
        remarks.push_back(change.kind);
    if (differs(change.mode) && !change.mode.after.empty())
        remarks.push_back(textOf("mode", change.mode));
    if (differs(change.owner) && !change.owner.after.empty())
        remarks.push_back(textOf("owner", change.owner));
    if (change.isBackup && !change.removed.empty())
        remarks.push_back(countOf(change.removed, "removed"));
    if (change.isBackup && !change.added.empty())
        remarks.push_back(countOf(change.added, "added"));
    return remarks.empty() ? "" : fmt::format(" ({})", fmt::join(remarks, ", "));
}

} // namespace

std::vector<std::string> missingIn(std::vector<std::string> const& lines,
                                   std::vector<std::string> const& others)
{
    std::unordered_map<std::string_view, std::size_t> counts;
    for (std::string const& line : others)
        ++counts[line];
    std::vector<std::string> missing;
    for (std::string const& line : lines) {
        auto const found = counts.find(line);
        if (found == counts.end() || found->second == 0)
            missing.push_back(line);
        else
            --found->second;
    }
    return missing;
}

void hideHash(std::string& record, std::size_t field)
{
    std::size_t start = 0;
    for (; field > 0; --field) {
        start = record.find(':', start) + 1;
        if (start == 0)
            return;
    }
    std::size_t const length = std::min(record.find(':', start), record.size()) - start;
    // The field of an account without a password.
    bool const isNone = record.substr(start, length).find_first_not_of("!*x") == std::string::npos;
    if (!isNone)
        record.replace(start, length, "(hidden)");
}

Json toJson(FileChange const& change)
{
    Json document{{"file", toJson(change.file)},
                  {"change", change.change},
                  {"kind", change.kind},
                  {"removed", listToJson(change.removed)},
                  {"added", listToJson(change.added)}};
    if (differs(change.mode))
        document["mode"] = attributeToJson(change.mode);
    if (differs(change.owner))
        document["owner"] = attributeToJson(change.owner);
    if (change.isBackup)
        document["backup"] = true;
    return document;
}

void writeText(std::vector<FileChange> const& changes, Output& out)
{
    for (FileChange const& change : changes) {
        out.line(change.change + " " + printable(change.file) + remark(change));
        if (change.isBackup)
            continue; // more than this write differs, and it was not requested
        for (std::string const& line : change.removed)
            out.line("  - " + printable(line));
        for (std::string const& line : change.added)
            out.line("  + " + printable(line));
    }
}

} // namespace mihost
