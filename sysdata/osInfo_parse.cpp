// Method-call texts: taken apart here, carried out by the executor.

#include "host/Methods.h"
#include "sysdata/osInfo_commands.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/osInfo_log.h"
#include "util/MyProcess.h"
#include "util/textTools.h"

#include <algorithm>
#include <cstdio>

namespace NQ
{

namespace
{

using os::methods;
using os::ParamType;

enum class Outcome { next, stop, reject };

bool isPassword(std::string const& item)
{
    std::vector<std::string> const parts = text::split(item, ":");
    return !parts.empty() && parts.front() == IC::parameter::password;
}

/** Year, month and day of a date-time text; its time of day, fraction and offset are dropped. */
bool readDate(std::string const& text, std::string& date)
{
    int year = 0, month = 0, day = 0, time = 0, fraction = 0, offset = 0;
    if (std::sscanf(text.c_str(), "%4d%2d%2d%6d.%6d+%3d", &year, &month, &day, &time, &fraction,
                    &offset) != 6 &&
        std::sscanf(text.c_str(), "%4d%2d%2d%6d.%6d-%3d", &year, &month, &day, &time, &fraction,
                    &offset) != 6)
        return false;
    char buffer[64];
    std::snprintf(buffer, sizeof buffer, "%d-%d-%d", year, month, day);
    date = buffer;
    return true;
}

Outcome stopAtBlank(log::Scope const& scope)
{
    scope.progress("This parameter is blank ---exiting ");
    return Outcome::stop;
}

/**
 * The parts of an item.
 *
 * @param secret  keeps them out of the log: a comma in a password makes items of its pieces
 */
std::vector<std::string> partsOf(std::string const& item, bool secret)
{
    std::vector<std::string> parts;
    if (!secret) {
        Tokenize(item, parts, ":");
        return parts;
    }
    // Tokenize does not log a text that holds this word.
    Tokenize(item + ":" + IC::parameter::password, parts, ":");
    parts.pop_back();
    return parts;
}

/** Takes one item and appends the parameter that it makes. */
Outcome parseItem(std::string const& item, bool secret, std::vector<ParamInfo>& params,
                  log::Scope const& scope)
{
    std::vector<std::string> const parts = partsOf(item, secret);
    if (parts.size() < 2)
        return stopAtBlank(scope);

    ParamInfo param{parts[0], parts[1], ""};
    scope.progress("paramInfo.name=", param.name);
    scope.progress("paramInfo.type=", param.type);
    ParamType const type = os::typeOf(param.type);
    if (type == ParamType::unknown) {
        scope.error(os::unknownType, param.type);
        return Outcome::reject;
    }

    bool const hasValue = parts.size() > 2;
    bool const date = type == ParamType::date;
    if (!hasValue && !date)
        return stopAtBlank(scope);
    if (hasValue) {
        if (!date)
            param.value = parts[2];
        else if (!readDate(parts[2], param.value))
            return Outcome::reject;
        if (date || param.name != IC::parameter::password)
            scope.progress("paramInfo.value=", param.value);
    }
    params.push_back(param);
    return Outcome::next;
}

} // namespace

int OsInfo::parseMethodAndParams(std::string methodAndParams, std::string& method,
                                 std::vector<ParamInfo>& params)
{
    log::Scope const scope(methods, {"OsNode::parseMethodAndParams"});
    std::vector<std::string> items;
    Tokenize(methodAndParams, items, ",");
    if (items.empty())
        return 0;
    method = items.front();
    scope.progress("method=", method);
    bool const secret = std::any_of(items.begin() + 1, items.end(), isPassword);
    for (auto item = items.begin() + 1; item != items.end(); ++item) {
        Outcome const outcome = parseItem(*item, secret, params, scope);
        if (outcome != Outcome::next)
            return outcome == Outcome::reject ? 1 : 0;
    }
    return 0;
}

} // namespace NQ
