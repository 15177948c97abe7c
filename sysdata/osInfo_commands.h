#ifndef SYSDATA_OSINFO_COMMANDS_H
#define SYSDATA_OSINFO_COMMANDS_H

#include "sysdata/ParamInfo.h"
#include "util/internal.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

/** From an administration method and its parameters to command lines. Nothing here runs any. */
namespace NQ
{

namespace MI_INTERNAL os
{

enum class ParamType { text, number, date, unknown };

ParamType typeOf(std::string const& name);

/** The value as it is on a command line, each blank after a backslash. */
std::string withEscapedBlanks(std::string const& value);

/** What a method needs beyond its program. */
enum class MethodKind {
    userAdd,
    userDel,
    userSetAttrib,
    userSetFullName,
    getShadowing,    // runs nothing
    groupMembership, // done by groupMemberChanges
    plain
};

/** The place of the account name in a method's command. */
enum class AccountName { nowhere, amongOthers, last };

struct Method {
    char const* name;
    MethodKind kind;
    char const* program = "";
    AccountName accountName = AccountName::nowhere;
};

/** Null for an unknown method. */
Method const* findMethod(std::string const& name);

/** A program and its arguments. Contract: the first empty argument ends the list when it is run. */
using Arguments = std::vector<std::string>;

/** Bytes in a command line or in what it prints, the terminating NUL included. */
constexpr std::size_t bufferSize = 5000;

/** The shell line of a list, standard error merged in. */
std::string commandLine(Arguments const& arguments);

/** The commands of one call. */
struct Commands {
    Arguments main;
    Arguments aging; // chage's list; run for UserAdd only, whose tool takes no ageing options
    std::optional<std::string> password;
    std::string user;
    bool expires = false; // an expiry date was given
};

/** Why a call was refused. */
struct Complaint {
    char const* text = nullptr; // null: nothing is logged
    std::string about;          // ends the message
};

/**
 * Builds the commands of one call. A list holds at most 39 arguments of 254 characters, and its
 * line must fit the buffer.
 *
 * @param program    what to run; the method's own program, possibly with options
 * @param complaint  set on failure
 */
bool makeCommands(Method const& method, std::string const& program,
                  std::vector<ParamInfo> const& params, Commands& commands, Complaint& complaint);

/** Whether the output begins with a text by which an account tool reports no error. */
bool isBenign(std::string const& output);

/** Whether the output begins with one of chage's own notices. */
bool isAgingNotice(std::string const& output);

} // namespace os

} // namespace NQ

#endif
