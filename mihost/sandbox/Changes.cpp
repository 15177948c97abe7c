#include "mihost/sandbox/Changes.h"

#include "mihost/sandbox/LayerFiles.h"
#include "mihost/sandbox/Layers.h"

#include <algorithm>
#include <set>

namespace mihost
{

namespace
{

constexpr char textDirectory[] = "/etc/";

bool mayHaveText(std::string const& path)
{
    return path.rfind(textDirectory, 0) == 0;
}

bool sameTime(timespec const& one, timespec const& other)
{
    return one.tv_sec == other.tv_sec && one.tv_nsec == other.tv_nsec;
}

bool sameState(FileState const& one, FileState const& other)
{
    return one.mode == other.mode && one.owner == other.owner && one.group == other.group &&
           one.target == other.target;
}

} // namespace

/** Compares two states of one layer. */
class LayerComparison
{
public:
    using Entries = CopyState::Entries;

    LayerComparison(Layer const& layer, Entries const& before, Entries const& after)
        : layer_(layer), before_(before), after_(after)
    {
    }

    void addTo(std::vector<PathChange>& changes) const
    {
        for (std::string const& path : paths()) {
            auto const old = find(before_, path);
            auto const now = find(after_, path);
            if (old || now)
                addTo(changes, path, old, now);
        }
    }

private:
    /** What a path led to: something that was written, or the machine's own. */
    struct Found {
        struct stat status;
        CopyState::Entry const* written; // null for the machine's own
    };

    static bool hides(Entries const& entries, std::string const& path)
    {
        auto const found = entries.find(path);
        return found != entries.end() &&
               (found->second.opaque || !S_ISDIR(found->second.status.st_mode));
    }

    /** The files that may differ: written in one of the states, or hidden by only one of them. */
    std::set<std::string> paths() const
    {
        std::set<std::string> written;
        for (Entries const* entries : {&before_, &after_})
            for (auto const& entry : *entries)
                written.insert(entry.first);
        std::set<std::string> all = written;
        for (std::string const& path : written) {
            if (hides(before_, path) == hides(after_, path))
                continue;
            auto const status = layerFiles::statusOf(layer_.machine, path);
            if (status && S_ISDIR(status->st_mode))
                layerFiles::walk(
                    layer_.machine, path,
                    [&all](std::string const& below, struct stat const&) { all.insert(below); });
        }
        return all;
    }

    std::optional<Found> find(Entries const& entries, std::string const& path) const
    {
        auto const written = entries.find(path);
        if (written != entries.end()) {
            if (layerFiles::isWhiteout(written->second.status))
                return std::nullopt;
            return Found{written->second.status, &written->second};
        }
        for (std::size_t end = path.rfind('/'); end != 0; end = path.rfind('/', end - 1))
            if (hides(entries, path.substr(0, end)))
                return std::nullopt;
        if (auto const status = layerFiles::statusOf(layer_.machine, path))
            return Found{*status, nullptr};
        return std::nullopt;
    }

    FileState stateOf(Found const& found, std::string const& path) const
    {
        FileState state{found.status.st_mode, found.status.st_uid, found.status.st_gid, ""};
        if (found.written)
            state.target = found.written->target;
        else if (S_ISLNK(state.mode))
            state.target = layerFiles::targetOf(layer_.machine, path);
        return state;
    }

    /** Empty for a missing file, none for a file that is not text. */
    std::optional<std::string> textOf(std::optional<Found> const& found,
                                      std::string const& path) const
    {
        if (!found)
            return "";
        if (!S_ISREG(found->status.st_mode))
            return std::nullopt;
        return found->written ? found->written->text : layerFiles::textOf(layer_.machine, path);
    }

    bool sameContent(Found const& old, Found const& now, std::string const& path) const
    {
        if (!S_ISREG(old.status.st_mode))
            return old.status.st_rdev == now.status.st_rdev;
        if (old.status.st_size != now.status.st_size)
            return false;
        if (!old.written && !now.written)
            return true;
        if (!old.written)
            return layerFiles::sameContent(layer_.machine, layer_.written, path);
        // The old content is lost, except for texts.
        if (old.written->text && now.written && now.written->text)
            return old.written->text == now.written->text;
        return old.status.st_ino == now.status.st_ino &&
               sameTime(old.status.st_mtim, now.status.st_mtim);
    }

    void addTo(std::vector<PathChange>& changes, std::string const& path,
               std::optional<Found> const& old, std::optional<Found> const& now) const
    {
        PathChange change{layer_.path + path, {}, {}, {}, {}};
        if (old)
            change.before = stateOf(*old, path);
        if (now)
            change.after = stateOf(*now, path);
        if (old && now && sameState(*change.before, *change.after) && sameContent(*old, *now, path))
            return;
        if (mayHaveText(change.path)) {
            change.oldText = textOf(old, path);
            change.newText = textOf(now, path);
            if (!change.oldText || !change.newText) {
                change.oldText.reset();
                change.newText.reset();
            }
        }
        changes.push_back(std::move(change));
    }

    Layer const& layer_;
    Entries const& before_;
    Entries const& after_;
};

CopyState CopyState::read()
{
    CopyState state;
    for (Layer const& layer : layers()) {
        Entries& entries = state.layers_.emplace_back();
        layerFiles::walk(
            layer.written, "", [&](std::string const& path, struct stat const& status) {
                Entry& entry = entries[path];
                entry.status = status;
                entry.opaque = S_ISDIR(status.st_mode) && layerFiles::isOpaque(layer.written, path);
                if (S_ISLNK(status.st_mode))
                    entry.target = layerFiles::targetOf(layer.written, path);
                if (S_ISREG(status.st_mode) && mayHaveText(layer.path + path))
                    entry.text = layerFiles::textOf(layer.written, path);
            });
    }
    return state;
}

std::vector<PathChange> CopyState::changesTo(CopyState const& later) const
{
    std::vector<PathChange> changes;
    for (std::size_t at = 0; at < layers_.size(); ++at)
        LayerComparison(layers()[at], layers_[at], later.layers_[at]).addTo(changes);
    std::sort(changes.begin(), changes.end(),
              [](PathChange const& one, PathChange const& other) { return one.path < other.path; });
    return changes;
}

} // namespace mihost
