#include "mihost/cli/AccountFiles.h"

#include "mihost/cli/Lines.h"

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
    {"/etc/gshadow", true},
};

std::vector<std::string> linesIn(AccountFiles const& all, char const* path)
{
    auto const found = all.find(path);
    return found == all.end() ? std::vector<std::string>() : found->second;
}

} // namespace

std::vector<std::string> fieldsOf(std::string const& line, char separator)
{
    std::vector<std::string> fields;
    std::size_t start = 0;
    for (std::size_t end = 0; end != std::string::npos; start = end + 1) {
        end = line.find(separator, start);
        fields.push_back(line.substr(start, end - start));
    }
    return fields;
}

Record recordOf(std::string const& file, std::string const& name)
{
    constexpr std::size_t mostFields = 9; // of a shadow record
    std::string const start = name + ':';
    for (std::string const& line : linesOf(contentOf(file)))
        if (line.compare(0, start.size(), start) == 0) {
            Record record = fieldsOf(line, ':');
            record.resize(std::max(record.size(), mostFields));
            return record;
        }
    return {};
}

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
