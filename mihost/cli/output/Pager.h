#ifndef MIHOST_CLI_OUTPUT_PAGER_H
#define MIHOST_CLI_OUTPUT_PAGER_H

#include <string>

namespace mihost
{

/** The user's pager, as a line for the shell: MIHOST_PAGER, PAGER or less. Empty for none. */
std::string pagerCommand();

/**
 * Shows the text in the pager and waits for its end. Restores the terminal.
 *
 * @return false if there is no such pager; a warning says so, and nothing was shown
 */
bool showInPager(std::string const& command, std::string const& text);

} // namespace mihost

#endif
