#ifndef MIHOST_CLI_CHECK_LOGRULES_H
#define MIHOST_CLI_CHECK_LOGRULES_H

#include "mihost/cli/check/LogRecord.h"
#include "mihost/cli/check/Verdict.h"

/** What holds for every message that a plug-in logs. */
namespace mihost::checks
{

using LoggedCalls = std::vector<LoggedCall>;

/** Each message is logged and then traced, with the same arguments. */
Findings wrongRepeats(LoggedCalls const& calls);

/** A function, a unit and a line are named; then come a null pointer and two zeros. */
Findings wrongArguments(LoggedCalls const& calls);

Findings wrongLevels(LoggedCalls const& calls);
Findings wrongCategories(LoggedCalls const& calls);

/**
 * Entries and exits nest. Some entries have no exit: those of the node classes' constructors and
 * destructors, and the one of a method call.
 */
Findings wrongNesting(LoggedCalls const& calls);

/** The rules above as checks of the subject's log so far. */
std::vector<Check> logChecks();

} // namespace mihost::checks

#endif
