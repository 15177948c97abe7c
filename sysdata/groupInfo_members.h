#ifndef SYSDATA_GROUPINFO_MEMBERS_H
#define SYSDATA_GROUPINFO_MEMBERS_H

#include "util/internal.h"

#include <string>
#include <unordered_map>

/** How a group's members are put together. Nothing here logs. */
namespace NQ
{

namespace GROUP_INFO
{

/** Who has which group as primary group, as /etc/passwd said when the object was made. */
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
 * Appends to a members field each name, followed by ",", unless the field holds that very text
 * somewhere already; then takes the last "," away.
 *
 * @param field    names, each followed by ","
 * @param members  ended by a null pointer
 */
MI_INTERNAL std::string withMembers(std::string field, char const* const* members);

} // namespace GROUP_INFO

} // namespace NQ

#endif
