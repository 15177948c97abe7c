#ifndef MIHOST_CLI_CHECK_SYMBOLS_H
#define MIHOST_CLI_CHECK_SYMBOLS_H

#include "mihost/cli/check/Verdict.h"

#include <string>
#include <vector>

namespace mihost::checks
{

/** A name of a library's dynamic symbol table. */
struct Symbol {
    std::string name;
    bool defined;
    bool weak;
    bool versioned; // an undefined one that names the version of a library, as those of libc do
};

/** The symbols that a loaded library defines and needs. @throws std::runtime_error if it is not
 * loaded */
std::vector<Symbol> symbolsOf(std::string const& file);

/** Undefined names that no header of the contract declares, although something provides them. */
Findings wantedBeyondTheContract(std::vector<Symbol> const& symbols, std::string const& file);

/** Whether the name is one of the host's: in its three namespaces. */
bool isHostName(std::string const& symbol);

/** Names that tools may rely on, without parameters: "NQ::OsInfo::getOSName". */
std::vector<char const*> const& publicNames();

/** The public names that the library does not define. */
std::vector<std::string> missingPublicNames(std::vector<Symbol> const& symbols);

} // namespace mihost::checks

#endif
