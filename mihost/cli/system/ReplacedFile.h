#ifndef MIHOST_CLI_SYSTEM_REPLACEDFILE_H
#define MIHOST_CLI_SYSTEM_REPLACEDFILE_H

#include <string>

namespace mihost
{

/**
 * Puts a file with this text in the place of the one at the path, if there is one. A reader sees
 * the old text or the new one, never a part. Everybody can read it.
 *
 * @param doing  what is being done, for the message
 * @throws Failure; the old file is then as it was, and nothing else is left
 */
void replaceFile(std::string const& path, std::string const& text, char const* doing);

} // namespace mihost

#endif
