#ifndef MIHOST_CLI_INPUT_INPUTVALIDATION_H
#define MIHOST_CLI_INPUT_INPUTVALIDATION_H

#include "mihost/cli/catalogue/Catalogue.h"

#include <optional>
#include <string>
#include <string_view>

/**
 * What may be handed to the plug-in. It puts texts into shell lines as they are, and runs those as
 * root; nothing but this stands between.
 */
namespace mihost
{

/** Bytes that mean something to a shell, one way or another. */
constexpr std::string_view shellMetacharacters = "|&;<>()$`\\\"'*?[]#~=%!{}^";

/** A command's argument may be this long, blanks escaped. */
constexpr std::size_t longestArgument = 254;

/**
 * Why a text may not be handed on as one value of a method call or as an account's name; nothing
 * where it may. The reason does not repeat passwords.
 *
 * Refused in every form: shell metacharacters, control characters, bytes that are no UTF-8, the
 * separators "," and ":", what is empty, and what is too long.
 */
std::optional<std::string> objection(Form form, std::string_view text);

/** Why a text is no password hash as the shadow file holds it; nothing where it is one. */
std::optional<std::string> objectionToHash(std::string_view text);

} // namespace mihost

#endif
