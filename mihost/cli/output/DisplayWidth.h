#ifndef MIHOST_CLI_OUTPUT_DISPLAYWIDTH_H
#define MIHOST_CLI_OUTPUT_DISPLAYWIDTH_H

#include <locale.h>
#include <string>
#include <string_view>
#include <vector>

namespace mihost
{

/** While it exists, this thread uses UTF-8 instead of the user's code set. */
class UnicodeCharacters
{
public:
    UnicodeCharacters();
    ~UnicodeCharacters();
    UnicodeCharacters(UnicodeCharacters const&) = delete;
    UnicodeCharacters& operator=(UnicodeCharacters const&) = delete;

    /** False on machines without any UTF-8 locale, where this class changes nothing. */
    static bool areAvailable();

private:
    locale_t before_;
};

/** Columns that a text takes on a terminal. The text is printable UTF-8. */
std::size_t displayWidth(std::string_view text);

/**
 * The text in lines of that width, broken at blanks if there are any, and never between a
 * letter and its accent.
 */
std::vector<std::string> wrapped(std::string_view text, std::size_t width);

} // namespace mihost

#endif
