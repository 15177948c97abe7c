#ifndef MIHOST_CLI_INPUT_RANGE_H
#define MIHOST_CLI_INPUT_RANGE_H

#include <functional>
#include <string>

namespace mihost
{

/** A check for an option: what is wrong with a value that is not a number from least to most. */
std::function<std::string(std::string const&)> between(double least, double most);

} // namespace mihost

#endif
