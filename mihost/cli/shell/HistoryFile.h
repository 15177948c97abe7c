#ifndef MIHOST_CLI_SHELL_HISTORYFILE_H
#define MIHOST_CLI_SHELL_HISTORYFILE_H

#include "mihost/sandbox/Descriptor.h"

#include <string>
#include <vector>

namespace mihost
{

constexpr int historyLimit = 1000; // lines

/**
 * The file of the shell's history: $XDG_STATE_HOME/mihost/history, or .local/state/mihost/history
 * in the home directory; empty if neither variable names a directory.
 */
std::string historyPath();

/**
 * The lines of earlier shells, oldest first, in a file that only its owner can read.
 *
 * There is no history, and nothing fails, if the file's directory cannot be created or belongs to
 * another user: sudo may keep another user's home directory.
 */
class HistoryFile
{
public:
    /** Makes the directory. @param path  empty for no history */
    explicit HistoryFile(std::string const& path);

    /** The newest lines, at most historyLimit. If the file has more, it is cut to these. */
    std::vector<std::string> lines() const;

    /** Appends a line at once, so that it is kept however the shell ends. Several shells may do so.
     */
    void add(std::string const& line) const;

private:
    Descriptor open(std::string const& name, int flags) const;
    void replace(std::vector<std::string> const& lines) const;

    Descriptor directory_;
    std::string name_;
};

} // namespace mihost

#endif
