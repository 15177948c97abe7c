#ifndef MIHOST_CLI_ACCOUNTFILES_H
#define MIHOST_CLI_ACCOUNTFILES_H

#include "mihost/cli/NodeView.h"

#include <map>
#include <string>
#include <vector>

namespace mihost
{

constexpr char shadowFile[] = "/etc/shadow";

/** The lines of the files that hold the accounts, by path. Files that cannot be read are empty. */
using AccountFiles = std::map<std::string, std::vector<std::string>>;

AccountFiles readAccountFiles();

/** The lines that went and came in one file, each in the file's order. */
struct FileChange {
    std::string file;
    std::vector<std::string> removed;
    std::vector<std::string> added;
};

/** The files in which lines differ. Password hashes in them are hidden unless they are asked for.
 */
std::vector<FileChange> changesBetween(AccountFiles const& before, AccountFiles const& after,
                                       Secrets secrets);

} // namespace mihost

#endif
