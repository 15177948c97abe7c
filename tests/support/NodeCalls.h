#ifndef TESTS_SUPPORT_NODECALLS_H
#define TESTS_SUPPORT_NODECALLS_H

#include "tests/support/Shown.h"

#include <string>
#include <vector>

/**
 * Records the calls of the framework's node setters, in order, while it exists.
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

#endif
