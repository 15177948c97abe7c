#ifndef MIHOST_CLI_INPUT_METHODCALL_H
#define MIHOST_CLI_INPUT_METHODCALL_H

#include "mihost/cli/catalogue/Catalogue.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace mihost
{

/** A call that was checked value by value. */
struct MethodCall {
    struct Argument {
        Parameter const* parameter;
        std::string value; // as in the text form
    };

    Method const* method;
    std::vector<Argument> arguments; // in the order given; commands are built in it
};

/** Given instead of a secret to have it read from a prompt. */
constexpr char toBeAsked[] = "-";

/** Reads a value that is not on the command line; gets the parameter's name. */
using AskSecret = std::function<std::string(std::string const& name)>;

/**
 * A call from "NAME=VALUE" words. A password given as "-" is read from a prompt.
 *
 * @throws Failure (BadUsage) with what is wrong and what would be right
 */
MethodCall parseCall(std::string const& method, std::vector<std::string> const& assignments,
                     AskSecret const& ask);

/**
 * Contract: the plug-in has the shell print the exit status of every command line that contains
 * this word, and treats any output as a failure, except in the first command of UserAdd.
 */
constexpr std::string_view misjudgedWord = "useradd";

/** A value for a parameter, as a person writes it. */
struct Assignment {
    Parameter const* parameter;
    std::string label; // the user's name for the parameter
    std::string value;
};

/** @throws Failure (BadUsage) naming the label */
void checkAssignment(Assignment const& assignment);

/** A call from values. @throws Failure (BadUsage) as above */
MethodCall makeCall(Method const& method, std::vector<Assignment> const& assignments);

/** Whether property 74 only stores this text: the empty text and a new tree's. */
bool callsNothing(std::string const& text);

/** A call from its text form. @throws Failure (BadUsage) as above */
MethodCall takeApart(std::string const& text);

/** The text form, as property 74 takes it. */
std::string textOf(MethodCall const& call);

/** The value of a parameter, empty if it is not given. */
std::string valueOf(MethodCall const& call, std::string_view name);

/** What must be confirmed before it is carried out; empty for nothing. */
std::string dangerOf(MethodCall const& call);

} // namespace mihost

#endif
