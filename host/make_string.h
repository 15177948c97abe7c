#ifndef HOST_MAKE_STRING_H
#define HOST_MAKE_STRING_H

#include <string>

namespace NQ
{

/** A copy of the text; the empty string for a null pointer. */
std::string make_string(char const* text);

/** UTF-8 from wide text. */
std::string make_string(std::wstring const& text);

/**
 * Wide text from UTF-8. A byte that is not UTF-8 survives the conversion and back unchanged.
 */
std::wstring make_wstring(std::string const& text);

} // namespace NQ

#endif
