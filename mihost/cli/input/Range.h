#ifndef MIHOST_CLI_INPUT_RANGE_H
#define MIHOST_CLI_INPUT_RANGE_H

#include <functional>
#include <string>

namespace mihost
{

/** A check for an option: rejects values that are not numbers from least to most. */
std::function<std::string(std::string const&)> between(double least, double most);

/** The same for whole numbers, in decimal digits without leading zeros. */
std::function<std::string(std::string const&)> wholeBetween(unsigned int least, unsigned int most);

} // namespace mihost

#endif
