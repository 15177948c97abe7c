#ifndef NODES_VALUES_H
#define NODES_VALUES_H

#include "host/Error.h"
#include "host/MutableNode.h"
#include "host/PropertyValue.h"
#include "util/internal.h"

#include <initializer_list>
#include <string>
#include <vector>

/** Short forms for the values that the builders and the live reads make. */
namespace NODES MI_INTERNAL
{

// Every value carries the flag true.
IC::PropertyValue text(std::string const& value);
IC::PropertyValue texts(std::vector<std::string> const& values);
IC::PropertyValue number(unsigned int value);
IC::PropertyValue truth(bool value);
IC::PropertyValue enumeration(unsigned int value);

/** @param seconds  since 1970 */
IC::PropertyValue date(long seconds);

/** The numbers 0, 1 and 24, which several kinds of node carry under property 125. */
IC::PropertyValue fixedNumberList();

/** A value of kind 0, to be filled by a read. */
IC::PropertyValue emptyValue();

IC::Error success();
IC::Error failure();

struct Property {
    unsigned int id;
    IC::PropertyValue value;
};

/** Sets the properties through the node's own setProperty, in the order given. */
void setProperties(IC::MutableNode& node, std::initializer_list<Property> properties);

} // namespace MI_INTERNAL

#endif
