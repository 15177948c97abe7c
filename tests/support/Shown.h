#ifndef TESTS_SUPPORT_SHOWN_H
#define TESTS_SUPPORT_SHOWN_H

#include "host/PropertyValue.h"

#include <string>

/** @return kind, value and flag, such as "text abc true" or "numbers 0,1,24 true" */
std::string shown(IC::PropertyValue const& value);

#endif
