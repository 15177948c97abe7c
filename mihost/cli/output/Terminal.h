#ifndef MIHOST_CLI_OUTPUT_TERMINAL_H
#define MIHOST_CLI_OUTPUT_TERMINAL_H

#include <string>
#include <string_view>

/** The user's terminal, if there is one. */
namespace mihost::terminal
{

/** Columns of a descriptor's terminal; 0 if it is not one. */
unsigned int width(int descriptor);

/** Whether the terminal shows all of the printable text above its last line. */
bool fits(int descriptor, std::string_view text);

/** @return whether the user's code set has the characters for lines and ellipses */
bool hasUnicode();

/** @return whether prompts are possible: standard input is a terminal */
bool canAsk();

/** Asks on standard error. @return whether the answer was yes */
bool confirm(std::string const& question);

/**
 * Reads one line from standard input; at a terminal after a prompt and without showing it.
 *
 * @throws Failure if there is none
 */
std::string readSecret(std::string const& prompt);

} // namespace mihost::terminal

#endif
