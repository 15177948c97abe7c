#ifndef MIHOST_CLI_INPUT_INPUTVALIDATION_H
#define MIHOST_CLI_INPUT_INPUTVALIDATION_H

#include "mihost/cli/catalogue/Catalogue.h"

#include <optional>
#include <string>
#include <string_view>

/**
 * Decides what may be passed to the plug-in, which puts texts unchanged into command lines that a
 * shell runs as root. Only this protects the machine.
 */
namespace mihost
{

/** Bytes with a meaning in a shell. */
constexpr std::string_view shellMetacharacters = "|&;<>()$`\\\"'*?[]#~=%!{}^";

/** The longest argument of a command, in bytes, with escaped blanks. */
constexpr std::size_t longestArgument = 254;

/**
 * Why a text must not be passed as a value of a method call or as an account's name; nothing if it
 * may. The reason does not repeat passwords.
 *
 * Refused in every form: shell metacharacters, control characters, bytes that are not UTF-8, the
 * separators "," and ":", empty texts and texts that are too long.
 */
std::optional<std::string> objection(Form form, std::string_view text);

/** Why a text is not a password hash for the shadow file; nothing if it is one. */
std::optional<std::string> objectionToHash(std::string_view text);

} // namespace mihost

#endif
