#ifndef MIHOST_CLI_ACCOUNTFILES_H
#define MIHOST_CLI_ACCOUNTFILES_H

#include "mihost/cli/FileChange.h"
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

/** The files in which lines differ. Password hashes in them are hidden unless they are asked for.
 */
std::vector<FileChange> changesBetween(AccountFiles const& before, AccountFiles const& after,
                                       Secrets secrets);

} // namespace mihost

#endif
