#ifndef MIHOST_ACCEL_COMMANDFORM_H
#define MIHOST_ACCEL_COMMANDFORM_H

#include "mihost/accel/Answers.h"

#include <string_view>

namespace miaccel
{

/**
 * @return the operands of a command line that has the given form, such as "sed -n '#p' @"; nothing
 *         if it has another one. In a form, # is a line number from 1 on, @ the name of a file and
 *         ~ that of a module, none of which a shell would expand or a tool read as an option.
 */
std::optional<Operands> operandsOf(std::string_view form, std::string_view line);

} // namespace miaccel

#endif
