#ifndef SYSDATA_OSINFO_MEMBERS_H
#define SYSDATA_OSINFO_MEMBERS_H

#include "util/internal.h"

#include <string>

namespace NQ
{

namespace MI_INTERNAL os
{

/** What happens to a member. */
enum class Membership { add, remove };

/**
 * The supplementary groups that a member shall have, comma-separated. Runs nothing.
 *
 * @param identity     what id printed about the member
 * @param quotedGroup  the group to add or to leave out, in double quotes
 */
std::string supplementaryGroups(std::string const& identity, std::string const& quotedGroup,
                                Membership change);

} // namespace os

} // namespace NQ

#endif
