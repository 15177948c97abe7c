#ifndef MIHOST_CLI_CHECK_REPORT_H
#define MIHOST_CLI_CHECK_REPORT_H

#include "mihost/cli/check/Verdict.h"
#include "mihost/cli/output/Output.h"

/** The results of all checks in the forms that people and programs read. */
namespace mihost::checks
{

using Results = std::vector<Result>;

/** One line per check, findings below it, and a summary at the end. */
void writeText(Results const& results, Output& out);

/** The Test Anything Protocol, version 14. */
std::string tapText(Results const& results);

/** An XML document as JUnit writes it, a test suite for each scenario. */
std::string junitText(Results const& results);

/** For every other format. */
Table tableOf(Results const& results);

} // namespace mihost::checks

#endif
