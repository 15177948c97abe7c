#include "tests/support/WideTexts.h"

#include "host/make_string.h"
#include "tests/support/Next.h"

namespace
{
WideTexts* inUse = nullptr;
}

WideTexts::WideTexts()
{
    inUse = this;
}

WideTexts::~WideTexts()
{
    inUse = nullptr;
}

namespace NQ
{

std::wstring make_wstring(std::string const& text)
{
    static auto* const real = next<std::wstring(std::string const&)>(
        "_ZN2NQ12make_wstringERKNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEE");
    if (inUse)
        inUse->widened.push_back(text);
    return real(text);
}

std::string make_string(std::wstring const& text)
{
    static auto* const real = next<std::string(std::wstring const&)>(
        "_ZN2NQ11make_stringERKNSt7__cxx1112basic_stringIwSt11char_traitsIwESaIwEEE");
    std::string const narrow = real(text);
    if (inUse)
        inUse->narrowed.push_back(narrow);
    return narrow;
}

std::string make_string(char const* text)
{
    static auto* const real = next<std::string(char const*)>("_ZN2NQ11make_stringB5cxx11EPKc");
    std::string const made = real(text);
    if (inUse)
        inUse->made.push_back(made);
    return made;
}

} // namespace NQ
