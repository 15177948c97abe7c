#ifndef UTIL_TEXTTOOLS_H
#define UTIL_TEXTTOOLS_H

#include "util/internal.h"

#include <cstddef>
#include <string>
#include <vector>

/** Text functions that several units share. Not part of the plug-in's interface. */
namespace NQ
{

namespace MI_INTERNAL text
{

/**
 * Replaces characters in place, from the second one on; the first is always kept. A
 * replacement by NUL ends the text and the scan.
 *
 * @param s  NUL-terminated, may be empty
 */
void replaceAfterFirst(char* s, char from, char to);

/**
 * Prints into a buffer of the given size, as snprintf does.
 *
 * @return false if the text does not fit; the buffer then holds its beginning
 */
bool print(char* buffer, std::size_t size, char const* format, ...)
    __attribute__((format(printf, 3, 4)));

/** Every maximal run of characters of the text that holds no delimiter, in order. */
std::vector<std::string> split(std::string const& text, std::string const& delimiters);

} // namespace text

} // namespace NQ

#endif
