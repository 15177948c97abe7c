#ifndef NODES_NODEVALUES_H
#define NODES_NODEVALUES_H

#include "host/Error.h"
#include "host/MutableNode.h"
#include "host/PropertyValue.h"
#include "util/internal.h"

#include <initializer_list>
#include <string>
#include <vector>

namespace IC
{

/** Short forms for the values that the builders and the live reads make. */
namespace MI_INTERNAL values
{

// Every value carries the flag true.
PropertyValue text(std::string const& value);
PropertyValue texts(std::vector<std::string> const& values);
PropertyValue number(unsigned int value);
PropertyValue truth(bool value);
PropertyValue enumeration(unsigned int value);

/** @param seconds  since 1970 */
PropertyValue date(long seconds);

/** The numbers 0, 1 and 24, which several kinds of node carry under property::fixedNumbers. */
PropertyValue fixedNumberList();

/** A value of kind 0, to be filled by a read. */
PropertyValue emptyValue();

/** What a host wrote, as text. Contract: through wide text and back. */
std::string textOf(PropertyValue const& value);

Error success();
Error failure();

struct Property {
    unsigned int id;
    PropertyValue value;
};

/** Sets the properties through the node's own setProperty, in the order given. */
void setProperties(MutableNode& node, std::initializer_list<Property> properties);

} // namespace values

} // namespace IC

#endif
