#ifndef MIHOST_CLI_SYSTEM_REPLACEDFILE_H
#define MIHOST_CLI_SYSTEM_REPLACEDFILE_H

#include <string>

namespace mihost
{

/**
 * Replaces the file at the path atomically: a reader sees the old text or the new one, never a
 * part. The file is world-readable.
 *
 * @param doing  what is being done, for the message
 * @throws Failure; the old file is then unchanged, and nothing else is left
 */
void replaceFile(std::string const& path, std::string const& text, char const* doing);

} // namespace mihost

#endif
