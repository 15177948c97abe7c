#ifndef MIHOST_CLI_INPUT_VALUETEXT_H
#define MIHOST_CLI_INPUT_VALUETEXT_H

#include "host/PropertyValue.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <string>

namespace mihost
{

/**
 * @return a value of the property's kind, from the user's text
 *
 * @throws Failure (BadUsage) with the right form, or what it must not contain
 */
IC::PropertyValue parseValue(Property const& property, std::string const& text);

} // namespace mihost

#endif
