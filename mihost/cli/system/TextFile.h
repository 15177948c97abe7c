#ifndef MIHOST_CLI_SYSTEM_TEXTFILE_H
#define MIHOST_CLI_SYSTEM_TEXTFILE_H

#include <string>
#include <vector>

namespace mihost
{

/** The text of a file; empty if it cannot be read. */
std::string contentOf(std::string const& path);

/** The lines of a text, without their ends. */
std::vector<std::string> linesOf(std::string const& text);

} // namespace mihost

#endif
