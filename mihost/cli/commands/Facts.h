#ifndef MIHOST_CLI_COMMANDS_FACTS_H
#define MIHOST_CLI_COMMANDS_FACTS_H

#include "mihost/cli/output/Output.h"

#include <string>
#include <vector>

namespace mihost
{

/** One line about something, such as "UID" and "1000". */
struct Fact {
    std::string label;
    std::string value; // empty for none; need not be printable
};

/** Writes the facts as two columns. */
void writeFacts(std::vector<Fact> const& facts, Output& out);

} // namespace mihost

#endif
