#ifndef MIHOST_CLI_LOG_LOGFILE_H
#define MIHOST_CLI_LOG_LOGFILE_H

#include "mihost/sandbox/Descriptor.h"

#include <string>
#include <vector>

namespace mihost
{

/** A log that other programs append to, empty and replace. Only lines that have ended are read. */
class LogFile
{
public:
    /** @throws std::system_error if the file cannot be opened */
    explicit LogFile(std::string const& path);

    /** The newest lines, the newest last; newLines() continues after them. */
    std::vector<std::string> newestLines(std::size_t count);

    /**
     * @return the lines added since the last call. If the path leads to another file by now, and it
     *         is not empty, the rest of the old file comes first. An emptied file is read from its
     *         beginning.
     */
    std::vector<std::string> newLines();

private:
    void readTo(std::vector<std::string>& lines);
    bool takeNewFile();

    std::string path_;
    Descriptor file_;
    long long position_ = 0; // of the next read, also in a log of more than 2 GiB
    std::string unfinished_; // the start of a line that has not ended
};

} // namespace mihost

#endif
