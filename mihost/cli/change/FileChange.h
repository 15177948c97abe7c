#ifndef MIHOST_CLI_CHANGE_FILECHANGE_H
#define MIHOST_CLI_CHANGE_FILECHANGE_H

#include "mihost/cli/output/Json.h"
#include "mihost/cli/output/Output.h"

#include <string>
#include <vector>

namespace mihost
{

/** How one file changed. */
struct FileChange {
    /** Both are empty unless they differ; one is empty for a created or removed file. */
    struct Attribute {
        std::string before;
        std::string after;
    };

    std::string file;
    std::vector<std::string> removed; // lines, in the file's order
    std::vector<std::string> added;
    std::string change = "changed"; // or "created" or "removed"
    std::string kind = "file";      // or "directory", "link", "device", "pipe" or "socket"
    Attribute mode{};               // octal
    Attribute owner{};              // numbers, as in 1000:100
    bool isBackup = false;          // the account tools', such as /etc/passwd-
};

/** The lines that the others lack, each as often as it is missing there. */
std::vector<std::string> missingIn(std::vector<std::string> const& lines,
                                   std::vector<std::string> const& others);

/** Replaces a field of a record, the first being 0, unless it marks that there is none. */
void hideHash(std::string& record, std::size_t field);

Json toJson(FileChange const& change);

/** For people to read: of a backup the number of lines only. */
void writeText(std::vector<FileChange> const& changes, Output& out);

} // namespace mihost

#endif
