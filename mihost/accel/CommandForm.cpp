#include "mihost/accel/CommandForm.h"

#include <algorithm>

namespace miaccel
{

namespace
{

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool isOfModuleName(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || isDigit(c) || c == '_' || c == '-';
}

/** Characters without a meaning to any shell. */
bool isOfFileName(char c)
{
    return isOfModuleName(c) || std::string_view("/.+,:@").find(c) != std::string_view::npos;
}

/** Removes the characters of a kind from the beginning of the line. @return them */
std::string take(std::string_view& line, bool (*isOfKind)(char))
{
    auto const end = std::find_if_not(line.begin(), line.end(), isOfKind);
    std::string word(line.begin(), end);
    line.remove_prefix(word.size());
    return word;
}

bool takeName(std::string_view& line, bool (*isOfKind)(char), Operands& operands)
{
    operands.name = take(line, isOfKind);
    return !operands.name.empty() && operands.name.front() != '-';
}

bool takeNumber(std::string_view& line, Operands& operands)
{
    constexpr std::size_t maxDigits = 18; // 64 bits hold them all
    std::string const digits = take(line, isDigit);
    if (digits.empty() || digits.size() > maxDigits || digits.front() == '0')
        return false;
    operands.line = std::stoull(digits);
    return true;
}

bool takeOne(char inForm, std::string_view& line, Operands& operands)
{
    if (inForm == '#')
        return takeNumber(line, operands);
    if (inForm == '@' || inForm == '~')
        return takeName(line, inForm == '@' ? isOfFileName : isOfModuleName, operands);
    bool const isThere = !line.empty() && line.front() == inForm;
    line.remove_prefix(isThere ? 1 : 0);
    return isThere;
}

} // namespace

std::optional<Operands> operandsOf(std::string_view form, std::string_view line)
{
    Operands operands;
    for (char const inForm : form)
        if (!takeOne(inForm, line, operands))
            return std::nullopt;
    return line.empty() ? std::optional(std::move(operands)) : std::nullopt;
}

} // namespace miaccel
