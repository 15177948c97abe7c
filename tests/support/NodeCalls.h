#ifndef TESTS_SUPPORT_NODECALLS_H
#define TESTS_SUPPORT_NODECALLS_H

#include "host/PropertyValue.h"

#include <string>
#include <vector>

/**
 * Notes what is asked of the framework's node setters, in order, for as long as it lives.
 *
 * Each call is a text such as "setStatus(1)", "setDescription(Driver)" or "setProperty(108)".
 */
class NodeCalls
{
public:
    NodeCalls();
    ~NodeCalls();
    NodeCalls(NodeCalls const&) = delete;
    NodeCalls& operator=(NodeCalls const&) = delete;

    std::vector<std::string> calls;
};

/** Kind, value and flag of a value, such as "text abc true" or "numbers 0,1,24 true". */
std::string shown(IC::PropertyValue const& value);

#endif
