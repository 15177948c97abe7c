#include "mihost/cli/log/LogLine.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <cstring>
#include <iterator>

namespace mihost
{

namespace
{

constexpr std::size_t longestLine = 511; // bytes that the plug-in reads of a line
constexpr std::size_t stampLength = 15;

constexpr char const* months[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                  "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
constexpr int december = 11;

/** Contract: anything but a month counts as January. */
int monthOf(char const* name)
{
    auto const found =
        std::find_if(std::begin(months), std::end(months),
                     [name](char const* month) { return std::strcmp(month, name) == 0; });
    return found == std::end(months) ? 0 : static_cast<int>(found - std::begin(months));
}

/** Contract: an entry of December is last year's in January; no other year is guessed. */
std::optional<long> timeOf(std::string const& stamp, std::tm const& today)
{
    char month[stampLength + 1] = "";
    std::tm time{};
    if (std::sscanf(stamp.c_str(), "%15s %d %d:%d:%d ", month, &time.tm_mday, &time.tm_hour,
                    &time.tm_min, &time.tm_sec) != 5)
        return std::nullopt;
    time.tm_mon = monthOf(month);
    bool const isLastYears = today.tm_mon == 0 && std::strcmp(month, months[december]) == 0;
    time.tm_year = today.tm_year - (isLastYears ? 1 : 0);
    time.tm_isdst = -1;
    std::time_t const seconds = std::mktime(&time);
    return seconds == -1 ? 0 : static_cast<long>(seconds);
}

} // namespace

LogLine logLineOf(std::string_view line, std::tm const& today)
{
    std::string_view read = line.substr(0, longestLine);
    read = read.substr(0, read.find('\0'));
    read.remove_prefix(std::min(read.find_first_not_of(' '), read.size()));
    std::string_view const message = read.substr(std::min(stampLength + 1, read.size()));
    return {timeOf(std::string(read.substr(0, stampLength)), today), std::string(message)};
}

bool hasStamp(std::string_view line)
{
    constexpr std::string_view form = " 00 00:00:00 "; // 0 means a digit; the first may be a blank
    constexpr std::size_t monthLength = 3;
    std::string_view const month = line.substr(0, monthLength);
    if (std::find(std::begin(months), std::end(months), month) == std::end(months))
        return false;
    std::string rest(line.substr(monthLength, form.size()));
    if (rest.compare(0, 2, "  ") == 0)
        rest[1] = '0';
    std::replace_if(
        rest.begin(), rest.end(),
        [](char character) { return std::isdigit(static_cast<unsigned char>(character)) != 0; },
        '0');
    return rest == form;
}

std::string withoutAsterisks(std::string const& message)
{
    bool const isQuoted = message.size() >= 2 && message.front() == '*' && message.back() == '*';
    return isQuoted ? message.substr(1, message.size() - 2) : message;
}

std::string withoutHostName(std::string const& message)
{
    std::size_t const end = message.find(' ');
    return end == std::string::npos ? message : message.substr(end + 1);
}

} // namespace mihost
