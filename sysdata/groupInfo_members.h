#ifndef SYSDATA_GROUPINFO_MEMBERS_H
#define SYSDATA_GROUPINFO_MEMBERS_H

#include "util/internal.h"

#include <string>
#include <unordered_map>

/** The list of a group's members. Nothing here logs. */
namespace NQ
{

namespace GROUP_INFO
{

/** The accounts by primary group, as in /etc/passwd when the object was made. */
class MI_INTERNAL PrimaryMembers
{
public:
    PrimaryMembers();

    /** The group's login names in the order of the file, each followed by ",". */
    std::string of(unsigned int groupId) const;

private:
    std::unordered_map<unsigned int, std::string> byGroup_;
};

/**
 * Appends each name and a "," to a members field, unless the field contains that text already; at
 * the end, removes the last ",".
 *
 * @param field    names, each followed by ","
 * @param members  ended by a null pointer
 */
MI_INTERNAL std::string withMembers(std::string field, char const* const* members);

} // namespace GROUP_INFO

} // namespace NQ

#endif
