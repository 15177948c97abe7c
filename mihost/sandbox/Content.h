#ifndef MIHOST_SANDBOX_CONTENT_H
#define MIHOST_SANDBOX_CONTENT_H

#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/** @throws std::system_error that names the path */
void copyContent(Descriptor const& from, Descriptor const& to, std::string const& path);

/** Writes all of the text. @throws std::system_error that names the path */
void writeAll(Descriptor const& to, char const* text, std::size_t length, std::string const& path);

} // namespace mihost

#endif
