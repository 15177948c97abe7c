#ifndef MIHOST_CLI_CHANGE_WRITE_H
#define MIHOST_CLI_CHANGE_WRITE_H

#include "mihost/cli/change/Expectation.h"
#include "mihost/cli/plugin/Session.h"

#include <string>
#include <vector>

namespace mihost
{

/** One write of a property, to be carried out. */
struct Write {
    std::string what; // such as "call UserAdd"
    IC::MutableNode& node;
    unsigned int property;
    IC::PropertyValue value;
    bool acts; // on the machine, not only in the tree
    std::vector<Expectation> expectations;
    std::vector<std::string> secrets;  // shown nowhere
    std::vector<std::string> warnings; // what the user should know first
    std::string tool;                  // the command whose success is the change; empty for none
};

/**
 * Prints the warnings, carries out the write, verifies the result, and reports the changes. In a
 * sandbox that includes the commands that were run and their output.
 *
 * A write of the present state succeeds and reports that nothing changed.
 *
 * @throws Failure (Failed) if the plug-in or a command refuses, or the change had no effect
 */
void carryOut(Session& session, Write const& write);

} // namespace mihost

#endif
