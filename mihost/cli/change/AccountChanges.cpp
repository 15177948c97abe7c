#include "mihost/cli/change/AccountChanges.h"

namespace mihost
{

namespace
{

constexpr std::size_t passwordField = 1; // the first being 0

std::vector<std::string> linesIn(AccountFiles const& all, char const* path)
{
    auto const found = all.find(path);
    return found == all.end() ? std::vector<std::string>() : found->second;
}

} // namespace

std::vector<FileChange> changesBetween(AccountFiles const& before, AccountFiles const& after,
                                       Secrets secrets)
{
    std::vector<FileChange> changes;
    for (char const* const path : {accountFile, shadowFile, groupFile, groupShadowFile}) {
        auto const old = linesIn(before, path);
        auto const now = linesIn(after, path);
        FileChange change;
        change.file = path;
        change.removed = missingIn(old, now);
        change.added = missingIn(now, old);
        if (change.removed.empty() && change.added.empty())
            continue;
        if (secrets == Secrets::Hide)
            for (auto* const lines : {&change.removed, &change.added})
                for (std::string& line : *lines)
                    hideHash(line, passwordField);
        changes.push_back(change);
    }
    return changes;
}

} // namespace mihost
