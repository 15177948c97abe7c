#ifndef MIHOST_CLI_CHANGE_PROPERTYWRITE_H
#define MIHOST_CLI_CHANGE_PROPERTYWRITE_H

#include "mihost/cli/change/Write.h"

namespace mihost
{

/**
 * The write of a catalogued property, except of a method call. It warns of side effects, or if
 * nothing outside the tree changes.
 */
Write propertyWrite(Session& session, IC::MutableNode& node, Property const& property,
                    IC::PropertyValue const& value);

/** What must be confirmed before a property is written; empty for nothing. */
std::string dangerOf(IC::MutableNode const& node, unsigned int property,
                     IC::PropertyValue const& value);

/**
 * The same as propertyWrite for an acting property of the operating-system node.
 *
 * @param what  the command that the user gave, such as "power halt"
 */
Write osWrite(Session& session, IC::MutableNode& os, std::string const& what, unsigned int property,
              IC::PropertyValue const& value);

} // namespace mihost

#endif
