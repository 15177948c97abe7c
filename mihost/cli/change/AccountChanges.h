#ifndef MIHOST_CLI_CHANGE_ACCOUNTCHANGES_H
#define MIHOST_CLI_CHANGE_ACCOUNTCHANGES_H

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/change/FileChange.h"
#include "mihost/cli/output/NodeView.h"

namespace mihost
{

/** The files in which lines differ. Password hashes are hidden unless secrets are shown. */
std::vector<FileChange> changesBetween(AccountFiles const& before, AccountFiles const& after,
                                       Secrets secrets);

} // namespace mihost

#endif
