#ifndef MIHOST_CLI_SYSTEM_INTERRUPTS_H
#define MIHOST_CLI_SYSTEM_INTERRUPTS_H

#include <termios.h>

/**
 * What happens on Ctrl-C and similar signals. By default the program cleans up and ends as the
 * signal would have ended it.
 */
namespace mihost::interrupts
{

/**
 * Takes over SIGINT, SIGTERM, SIGHUP and SIGQUIT, and keeps SIGPIPE and SIGXFSZ from ending the
 * program.
 */
void install();

/** @param path  a folder to remove when a signal ends the program; null for none */
void setFolderToRemove(char const* path);

/** @param settings  restored when a signal ends the program; null for none */
void setTerminalToRestore(termios const* settings);

/** @param text  written to standard error when a signal ends the program; null for none */
void setLastWords(char const* text);

} // namespace mihost::interrupts

#endif
