#include "mihost/cli/change/SandboxChanges.h"

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/system/TextFile.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>
#include <optional>
#include <string_view>

namespace mihost
{

namespace
{

// Account tools create them temporarily; the first one stays.
constexpr std::string_view lockFiles[] = {
    "/etc/.pwd.lock",    "/etc/passwd.lock", "/etc/shadow.lock", "/etc/group.lock",
    "/etc/gshadow.lock", "/etc/subuid.lock", "/etc/subgid.lock",
};

struct AccountFile {
    std::string_view path;
    std::optional<std::size_t> secret; // the field that may hold a hash, the first being 0
};

constexpr AccountFile accountFiles[] = {
    {accountFile, 1},
    {shadowFile, 1},
    {groupFile, 1},
    {groupShadowFile, 1},
    {"/etc/security/opasswd", 3},
    {"/etc/subuid", {}},
    {"/etc/subgid", {}},
};

/** The file itself or a backup that a tool keeps next to it, such as /etc/shadow- or
 * /etc/shadow.org.
 */
AccountFile const* accountFileOf(std::string_view path)
{
    for (AccountFile const& file : accountFiles) {
        bool const isCopy =
            path.size() > file.path.size() &&
            std::string_view("-+.~").find(path[file.path.size()]) != std::string_view::npos;
        if (path.substr(0, file.path.size()) == file.path &&
            (path.size() == file.path.size() || isCopy))
            return &file;
    }
    return nullptr;
}

bool isLeftOut(std::string const& path, std::string const& ownDirectory)
{
    bool const isOwn = !ownDirectory.empty() && path.rfind(ownDirectory + "/", 0) == 0;
    return isOwn ||
           std::find(std::begin(lockFiles), std::end(lockFiles), path) != std::end(lockFiles);
}

std::string kindOf(mode_t mode)
{
    if (S_ISREG(mode))
        return "file";
    if (S_ISDIR(mode))
        return "directory";
    if (S_ISLNK(mode))
        return "link";
    if (S_ISFIFO(mode))
        return "pipe";
    return S_ISSOCK(mode) ? "socket" : "device";
}

std::string modeOf(std::optional<FileState> const& state)
{
    return state ? fmt::format("{:04o}", state->mode & 07777U) : "";
}

std::string ownerOf(std::optional<FileState> const& state)
{
    return state ? fmt::format("{}:{}", state->owner, state->group) : "";
}

bool everybodyMayRead(std::optional<FileState> const& state)
{
    return !state || (state->mode & S_IROTH) != 0;
}

void addLines(FileChange& shown, PathChange const& change, AccountFile const* account,
              Secrets secrets)
{
    if (!change.oldText || !change.newText)
        return;
    bool const isPublic = everybodyMayRead(change.before) && everybodyMayRead(change.after);
    if (secrets == Secrets::Hide && !account && !isPublic)
        return;
    auto const before = linesOf(*change.oldText);
    auto const after = linesOf(*change.newText);
    shown.removed = missingIn(before, after);
    shown.added = missingIn(after, before);
    if (secrets == Secrets::Hide && account && account->secret)
        for (auto* const lines : {&shown.removed, &shown.added})
            for (std::string& line : *lines)
                hideHash(line, *account->secret);
}

std::vector<std::string> targetOf(std::optional<FileState> const& state)
{
    if (!state || !S_ISLNK(state->mode))
        return {};
    return {"-> " + state->target};
}

FileChange shownOf(PathChange const& change, Secrets secrets)
{
    FileChange shown;
    shown.file = change.path;
    AccountFile const* const account = accountFileOf(change.path);
    shown.isBackup = account && account->path != change.path;
    if (!change.before)
        shown.change = "created";
    if (!change.after)
        shown.change = "removed";
    shown.kind = kindOf((change.after ? change.after : change.before)->mode);
    shown.mode = {modeOf(change.before), modeOf(change.after)};
    shown.owner = {ownerOf(change.before), ownerOf(change.after)};
    shown.removed = missingIn(targetOf(change.before), targetOf(change.after));
    shown.added = missingIn(targetOf(change.after), targetOf(change.before));
    addLines(shown, change, account, secrets);
    return shown;
}

/** @return whether a file was replaced by one of another kind: shown as removed and created */
bool isReplaced(PathChange const& change)
{
    return change.before && change.after &&
           kindOf(change.before->mode) != kindOf(change.after->mode);
}

} // namespace

std::vector<FileChange> shownChanges(std::vector<PathChange> const& changes,
                                     std::string const& ownDirectory, Secrets secrets)
{
    std::vector<FileChange> shown;
    for (PathChange const& change : changes) {
        if (isLeftOut(change.path, ownDirectory))
            continue;
        if (isReplaced(change)) {
            shown.push_back(shownOf({change.path, change.before, {}, {}, {}}, secrets));
            shown.push_back(shownOf({change.path, {}, change.after, {}, {}}, secrets));
        } else {
            shown.push_back(shownOf(change, secrets));
        }
    }
    return shown;
}

} // namespace mihost
