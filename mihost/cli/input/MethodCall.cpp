#include "mihost/cli/input/MethodCall.h"

#include "host/Methods.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

Method const& method(std::string_view name)
{
    Method const* const found = findMethod(name);
    if (!found)
        throw Failure(BadUsage, fmt::format("no method '{}' ({})", name,
                                            suggestion(name, rowNames(methods()), "use")));
    return *found;
}

Parameter const& parameter(Method const& method, std::string_view name)
{
    Parameter const* const found = findParameter(method, name);
    if (!found)
        throw Failure(BadUsage,
                      fmt::format("{} has no parameter '{}' ({})", method.name, name,
                                  suggestion(name, rowNames(method.parameters), "it has")));
    return *found;
}

void checkWhole(MethodCall const& call)
{
    for (Parameter const& parameter : call.method->parameters) {
        auto const given = std::count_if(
            call.arguments.begin(), call.arguments.end(),
            [&parameter](auto const& argument) { return argument.parameter == &parameter; });
        if (given > 1)
            throw Failure(BadUsage, fmt::format("{} is given twice", parameter.name));
        if (given == 0 && parameter.required)
            throw Failure(BadUsage,
                          fmt::format("{0} needs {1}, {2} (see 'mihost methods {0}')",
                                      call.method->name, parameter.name, parameter.meaning));
    }
}

/** In UserAdd the first command contains all values, the second one only the name. */
void checkJudging(Method const& method, Assignment const& assignment)
{
    bool const isOfFirstCommand =
        std::string_view(method.name) == IC::method::userAdd &&
        std::string_view(assignment.parameter->name) != IC::parameter::userName;
    if (!isOfFirstCommand && assignment.value.find(misjudgedWord) != std::string::npos)
        throw Failure(BadUsage,
                      fmt::format("{} contains '{}', so the plug-in would report {} as failed even "
                                  "if it succeeds (use the account tools themselves)",
                                  assignment.label, misjudgedWord, method.name));
}

std::string toTextForm(Parameter const& parameter, std::string const& value)
{
    if (parameter.form != Form::Day)
        return value;
    return dateTimeText(*parseDay(value));
}

/** @return the pieces between separators without empty ones, as the plug-in splits */
std::vector<std::string> split(std::string const& text, char separator)
{
    std::vector<std::string> pieces;
    std::size_t start = 0;
    while ((start = text.find_first_not_of(separator, start)) != std::string::npos) {
        std::size_t const end = std::min(text.find(separator, start), text.size());
        pieces.push_back(text.substr(start, end - start));
        start = end;
    }
    return pieces;
}

/** @param value  in the text form */
void checkTextForm(Parameter const& parameter, std::string const& value)
{
    if (parameter.form != Form::Day)
        checkAssignment({&parameter, parameter.name, value});
    else if (!parseDateTime(value))
        throw Failure(BadUsage,
                      fmt::format("{} is not a date-time (use {})", parameter.name, dateTimeForm));
}

MethodCall::Argument argumentOf(Method const& method, std::string const& item)
{
    std::vector<std::string> const parts = split(item, ':');
    Parameter const& known = parameter(method, parts.empty() ? std::string_view() : parts[0]);
    if (parts.size() != 3)
        throw Failure(BadUsage,
                      fmt::format("{} is malformed (write {}:{}:VALUE, without ':' in VALUE)",
                                  known.name, known.name, known.type));
    if (parts[1] != known.type)
        throw Failure(BadUsage, fmt::format("{} has the type {}, not '{}'", known.name, known.type,
                                            parts[1]));
    checkTextForm(known, parts[2]);
    checkJudging(method, {&known, known.name, parts[2]});
    return {&known, parts[2]};
}

/** NAME=VALUE */
Assignment parseAssignment(Method const& method, std::string const& text, AskSecret const& ask)
{
    std::size_t const equals = text.find('=');
    if (equals == std::string::npos && !findParameter(method, text))
        throw Failure(BadUsage, fmt::format("'{}' is not NAME=VALUE ({})", text,
                                            suggestion(text, rowNames(method.parameters),
                                                       fmt::format("{} takes", method.name))));
    Parameter const& known = parameter(method, std::string_view(text).substr(0, equals));
    if (equals == std::string::npos)
        throw Failure(BadUsage, fmt::format("{0} needs a value (write {0}=VALUE)", known.name));
    std::string value = text.substr(equals + 1);
    if (known.form == Form::Password && value == toBeAsked)
        value = ask(known.name);
    return {&known, known.name, value};
}

} // namespace

MethodCall parseCall(std::string const& name, std::vector<std::string> const& assignments,
                     AskSecret const& ask)
{
    Method const& known = method(name);
    std::vector<Assignment> parsed;
    parsed.reserve(assignments.size());
    for (std::string const& assignment : assignments)
        parsed.push_back(parseAssignment(known, assignment, ask));
    return makeCall(known, parsed);
}

void checkAssignment(Assignment const& assignment)
{
    if (auto const reason = objection(assignment.parameter->form, assignment.value))
        throw Failure(BadUsage, fmt::format("{} {}", assignment.label, *reason));
}

MethodCall makeCall(Method const& method, std::vector<Assignment> const& assignments)
{
    MethodCall call{&method, {}};
    for (Assignment const& assignment : assignments) {
        checkAssignment(assignment);
        checkJudging(method, assignment);
        Parameter const& parameter = *assignment.parameter;
        call.arguments.push_back({&parameter, toTextForm(parameter, assignment.value)});
    }
    checkWhole(call);
    return call;
}

bool callsNothing(std::string const& text)
{
    return text.empty() || text == "dummy";
}

MethodCall takeApart(std::string const& text)
{
    std::vector<std::string> const items = split(text, ',');
    MethodCall call{&method(items.empty() ? std::string_view() : items[0]), {}};
    for (std::size_t at = 1; at < items.size(); ++at)
        call.arguments.push_back(argumentOf(*call.method, items[at]));
    checkWhole(call);
    return call;
}

std::string textOf(MethodCall const& call)
{
    std::string text = call.method->name;
    for (MethodCall::Argument const& argument : call.arguments)
        text += fmt::format(",{}:{}:{}", argument.parameter->name, argument.parameter->type,
                            argument.value);
    return text;
}

std::string valueOf(MethodCall const& call, std::string_view name)
{
    auto const found =
        std::find_if(call.arguments.begin(), call.arguments.end(),
                     [name](auto const& argument) { return argument.parameter->name == name; });
    return found == call.arguments.end() ? "" : found->value;
}

std::string dangerOf(MethodCall const& call)
{
    bool const deletes = std::string_view(call.method->name) == IC::method::userDel;
    return deletes && valueOf(call, IC::parameter::userName) == "root" ? "delete the account root"
                                                                       : "";
}

} // namespace mihost
