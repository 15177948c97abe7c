#ifndef MIHOST_CLI_INPUT_SUGGESTION_H
#define MIHOST_CLI_INPUT_SUGGESTION_H

#include <string>
#include <string_view>
#include <vector>

namespace mihost
{

/** The name that differs from the word only by case or one or two typing errors; empty for none. */
std::string nearest(std::string_view word, std::vector<std::string> const& names);

/**
 * What to write instead of a word that is not one of the names.
 *
 * @param lead  goes before the list of names, such as "use"
 */
std::string suggestion(std::string_view word, std::vector<std::string> const& names,
                       std::string_view lead);

} // namespace mihost

#endif
