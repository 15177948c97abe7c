#ifndef MIHOST_SANDBOX_CHANGES_H
#define MIHOST_SANDBOX_CHANGES_H

#include <map>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <vector>

namespace mihost
{

/** A file, directory, link or anything else that has a path. */
struct FileState {
    mode_t mode; // with its type
    uid_t owner;
    gid_t group;
    std::string target; // of a symbolic link
};

/** How one path changed. */
struct PathChange {
    std::string path;
    std::optional<FileState> before; // none: it did not exist
    std::optional<FileState> after;
    // Of a text file in /etc that is not too long, and empty for one that does not exist. Both or
    // none.
    std::optional<std::string> oldText;
    std::optional<std::string> newText;
};

/** Everything written in the copy of the machine so far, on every copied file system. */
class CopyState
{
public:
    /** Reads the present state; empty outside a copy. @throws std::system_error */
    static CopyState read();

    /**
     * What changed from this state to a later one: by path, each once, everything in a directory
     * that came or went included. A time stamp alone is not a change.
     *
     * @throws std::system_error
     */
    std::vector<PathChange> changesTo(CopyState const& later) const;

private:
    struct Entry {
        struct stat status;
        std::string target;
        bool opaque; // a directory that hides the machine's own
        std::optional<std::string> text;
    };
    using Entries = std::map<std::string, Entry>; // by the path in the layer

    friend class LayerComparison;

    std::vector<Entries> layers_;
};

} // namespace mihost

#endif
