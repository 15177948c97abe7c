#ifndef MIHOST_CLI_DOCTOR_FILECHECKS_H
#define MIHOST_CLI_DOCTOR_FILECHECKS_H

#include <optional>
#include <string>
#include <vector>

/** Problems that keep the plug-in from reading files; nothing if there are none. */
namespace mihost
{

using Problem = std::optional<std::string>;

/** @param text  of /etc/login.defs */
Problem problemOfRanges(std::string const& text);

/** @param text  of /etc/passwd */
Problem problemOfAccounts(std::string const& text);

/** @param text  of /etc/group */
Problem problemOfGroups(std::string const& text);

/**
 * The plug-in reads shadow entries only forward, so one that is missing, malformed or out of order
 * hides those of all later accounts.
 *
 * @param accounts  names of the accounts that are shown, in the order of /etc/passwd
 * @param text      of /etc/shadow
 */
Problem problemOfShadow(std::vector<std::string> const& accounts, std::string const& text);

/** @param text  of /etc/release: a line, then "NAME = MAJOR" and "NAME = MINOR" */
Problem problemOfRelease(std::string const& text);

/** @param lines  the newest lines of the system log, the newest last */
Problem problemOfStamps(std::vector<std::string> const& lines);

} // namespace mihost

#endif
