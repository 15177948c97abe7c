#ifndef MIHOST_CLI_OUTPUT_ROWS_H
#define MIHOST_CLI_OUTPUT_ROWS_H

#include "mihost/cli/output/Table.h"

#include <string>

/** Tables as rows without layout, for programs. Control characters are written as escapes. */
namespace mihost
{

/** Comma-separated values as in RFC 4180, but with the line ends of text files. */
std::string csvText(Table const& table, bool hasHeadings);

/** A line for each row, with tabs between its values. */
std::string valueText(Table const& table);

} // namespace mihost

#endif
