#ifndef MIHOST_CLI_SHELL_BASHCOMPLETION_H
#define MIHOST_CLI_SHELL_BASHCOMPLETION_H

#include "mihost/cli/shell/Completion.h"

#include <string>
#include <string_view>

namespace mihost
{

/**
 * @return what bash's completion script reads: a line that says words, files or folders, then a
 * line for each text that may replace the part of the typed word that readline replaces. bash
 *         inserts them unchanged, so they are quoted.
 *
 * @param line    the command line up to the cursor, the program's name included
 * @param breaks  bash's COMP_WORDBREAKS
 */
std::string bashCompletionText(std::string const& line, std::string const& breaks,
                               NodeNames const& names, CommandTable const& table);

/**
 * The text quoted for bash. It must not contain control characters.
 *
 * @param quote  the quote, ' or ", that is open before the text and closed after it; NUL for none
 */
std::string quotedForBash(std::string_view text, char quote);

} // namespace mihost

#endif
