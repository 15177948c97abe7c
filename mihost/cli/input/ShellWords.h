#ifndef MIHOST_CLI_INPUT_SHELLWORDS_H
#define MIHOST_CLI_INPUT_SHELLWORDS_H

#include <string>
#include <vector>

namespace mihost
{

/**
 * The words of a line, as a shell would split it: blanks separate, quotes and backslashes keep
 * together, # at the start of a word begins a comment. Nothing is expanded.
 *
 * @throws Failure (BadUsage) for a quote that does not end
 */
std::vector<std::string> splitWords(std::string const& line);

/** The words of a line up to the cursor, the last one being typed and perhaps empty. */
std::vector<std::string> wordsBeingTyped(std::string const& line);

/** A line up to the cursor, for an editor that replaces only a part of the word being typed. */
struct TypedLine {
    std::vector<std::string> words; // the last one is being typed and may be empty
    std::size_t kept = 0;           // bytes of the last word that stay as they are
    char quote = '\0';              // the quote that the cursor is in
};

/** @param breaks  the characters after which the replaced part begins if they are not quoted */
TypedLine typedLine(std::string const& line, std::string const& breaks);

/** Whether the line contains a password, so that it must not be kept. */
bool holdsPassword(std::string const& line);

/**
 * The word so that a shell reads it as this one word: POSIX shells, and fish and csh too, which
 * treat a backslash between quotes differently.
 */
std::string quotedForShell(std::string const& word);

} // namespace mihost

#endif
