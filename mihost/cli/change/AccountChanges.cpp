#include "mihost/cli/change/AccountChanges.h"

namespace mihost
{

namespace
{

struct File {
    char const* path;
    bool secret; // the password field of a line is a hash
};

constexpr std::size_t passwordField = 1; // the first being 0

constexpr File files[] = {
    {accountFile, false},
    {shadowFile, true},
    {groupFile, false},
    {groupShadowFile, true},
};

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
    for (File const& file : files) {
        auto const old = linesIn(before, file.path);
        auto const now = linesIn(after, file.path);
        FileChange change;
        change.file = file.path;
        change.removed = missingIn(old, now);
        change.added = missingIn(now, old);
        if (change.removed.empty() && change.added.empty())
            continue;
        if (file.secret && secrets == Secrets::Hide) {
            for (auto* const lines : {&change.removed, &change.added})
                for (std::string& line : *lines)
                    hideHash(line, passwordField);
        }
        changes.push_back(change);
    }
    return changes;
}

} // namespace mihost
