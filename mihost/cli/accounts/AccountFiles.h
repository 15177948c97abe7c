#ifndef MIHOST_CLI_ACCOUNTS_ACCOUNTFILES_H
#define MIHOST_CLI_ACCOUNTS_ACCOUNTFILES_H

#include <map>
#include <string>
#include <vector>

namespace mihost
{

constexpr char accountFile[] = "/etc/passwd";
constexpr char shadowFile[] = "/etc/shadow";
constexpr char groupFile[] = "/etc/group";
constexpr char groupShadowFile[] = "/etc/gshadow";

/** The fields of a record. */
namespace accountField
{
enum { Password = 1, Id, Group, Comment, Home, Shell };
}
namespace shadowField
{
enum { Password = 1, LastChange, MinDays, MaxDays, WarnDays, Inactive, Expiry };
}
namespace groupField
{
enum { Id = 2, Members };
}

/** A record's fields. */
using Record = std::vector<std::string>;

/**
 * The first record of this name; empty if there is none. Fields that are missing from its end are
 * empty.
 */
Record recordIn(std::vector<std::string> const& lines, std::string const& name);

/** The record of this name as the file has it now; empty if it has none or cannot be read. */
Record recordOf(std::string const& file, std::string const& name);

/** The first field of each record. */
std::vector<std::string> recordNames(std::vector<std::string> const& lines);

/** The pieces between separators, empty ones included. */
std::vector<std::string> fieldsOf(std::string const& line, char separator);

/** The lines of the files that hold the accounts, by path. Files that cannot be read are empty. */
using AccountFiles = std::map<std::string, std::vector<std::string>>;

AccountFiles readAccountFiles();

} // namespace mihost

#endif
