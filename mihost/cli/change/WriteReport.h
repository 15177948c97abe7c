#ifndef MIHOST_CLI_CHANGE_WRITEREPORT_H
#define MIHOST_CLI_CHANGE_WRITEREPORT_H

#include "mihost/cli/change/FileChange.h"
#include "mihost/cli/plugin/CommandTap.h"

#include <string>
#include <vector>

namespace mihost
{

/** The result of a write. */
struct WriteReport {
    std::string error;               // why it failed; empty if it did not
    bool changed;                    // the machine, in any way
    std::vector<FileChange> changes; // in a sandbox every file, elsewhere the account files
    std::vector<std::string> warnings;
    std::vector<commandTap::RunCommand> commands;
};

/** The document that commands print after a change; commands are part of it in a sandbox only. */
Json toJson(WriteReport const& report);

/** The commands and the changed files, for a person. */
void writeText(WriteReport const& report, Output& out);

} // namespace mihost

#endif
