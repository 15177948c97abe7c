#ifndef MIHOST_CLI_DIAGNOSIS_H
#define MIHOST_CLI_DIAGNOSIS_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/** One thing that a full tree needs. */
struct Need {
    std::string what;
    std::optional<std::string> problem; // nothing where all is well
    std::string cost;                   // what suffers without it
    std::string debian;                 // what mends it on Debian and its kin
    std::string redHat;                 // and on Red Hat and its kin
};

/** Looks at this machine. Changes nothing on it. */
std::vector<Need> diagnose();

// What is wrong with the contents of files; nothing where they are as the plug-in reads them.

/** @param text  of /etc/login.defs */
std::optional<std::string> problemOfRanges(std::string const& text);

/** @param text  of /etc/passwd */
std::optional<std::string> problemOfAccounts(std::string const& text);

/**
 * Shadow entries are matched going forward only.
 *
 * @param accounts  the names in /etc/passwd, in its order
 * @param shadow    those in /etc/shadow
 */
std::optional<std::string> problemOfShadowOrder(std::vector<std::string> const& accounts,
                                                std::vector<std::string> const& shadow);

/** @param lines  the newest lines of the system log, the newest last */
std::optional<std::string> problemOfStamps(std::vector<std::string> const& lines);

} // namespace mihost

#endif
