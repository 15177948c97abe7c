#ifndef MIHOST_CLI_INPUT_SUGGESTION_H
#define MIHOST_CLI_INPUT_SUGGESTION_H

#include <string>
#include <string_view>
#include <vector>

namespace mihost
{

/** The name that differs from the word by no more than case or a slip or two; empty for none. */
std::string nearest(std::string_view word, std::vector<std::string> const& names);

/**
 * What to write instead of a word that is none of the names.
 *
 * @param lead  what stands before all of the names, such as "it has"
 */
std::string suggestion(std::string_view word, std::vector<std::string> const& names,
                       std::string_view lead);

} // namespace mihost

#endif
