#include "mihost/cli/AccountFiles.h"

#include "mihost/cli/Lines.h"

#include <algorithm>

namespace mihost
{

namespace
{

struct File {
    char const* path;
    bool secret; // the second field of a line is a password hash
};

constexpr File files[] = {
    {"/etc/passwd", false},
    {shadowFile, true},
    {"/etc/group", false},
    {"/etc/gshadow", true},
};

std::vector<std::string> linesIn(AccountFiles const& all, char const* path)
{
    auto const found = all.find(path);
    return found == all.end() ? std::vector<std::string>() : found->second;
}

std::vector<std::string> missingIn(std::vector<std::string> const& lines,
                                   std::vector<std::string> const& others)
{
    std::vector<std::string> missing;
    std::copy_if(lines.begin(), lines.end(), std::back_inserter(missing),
                 [&others](std::string const& line) {
                     return std::find(others.begin(), others.end(), line) == others.end();
                 });
    return missing;
}

/** What stands in the second field of an account that has no password. */
bool saysNothing(std::string const& field)
{
    return field.find_first_not_of("!*x") == std::string::npos;
}

void hideHash(std::string& line)
{
    std::size_t const first = line.find(':');
    if (first == std::string::npos)
        return;
    std::size_t const second = std::min(line.find(':', first + 1), line.size());
    std::size_t const length = second - first - 1;
    if (!saysNothing(line.substr(first + 1, length)))
        line.replace(first + 1, length, "(hidden)");
}

} // namespace

AccountFiles readAccountFiles()
{
    AccountFiles all;
    for (File const& file : files)
        all[file.path] = linesOf(contentOf(file.path));
    return all;
}

std::vector<FileChange> changesBetween(AccountFiles const& before, AccountFiles const& after,
                                       Secrets secrets)
{
    std::vector<FileChange> changes;
    for (File const& file : files) {
        auto const old = linesIn(before, file.path);
        auto const now = linesIn(after, file.path);
        FileChange change{file.path, missingIn(old, now), missingIn(now, old)};
        if (change.removed.empty() && change.added.empty())
            continue;
        if (file.secret && secrets == Secrets::Hide) {
            std::for_each(change.removed.begin(), change.removed.end(), hideHash);
            std::for_each(change.added.begin(), change.added.end(), hideHash);
        }
        changes.push_back(change);
    }
    return changes;
}

} // namespace mihost
