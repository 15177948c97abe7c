#include "sysdata/groupInfo_members.h"

#include "util/file.h"

#include <algorithm>
#include <pwd.h>
#include <set>

namespace NQ::GROUP_INFO
{

namespace
{

/**
 * The pieces of a members field, to find whether it contains NAME followed by ",".
 *
 * It does if a piece ends in NAME. The pieces are kept back to front, so that such a piece begins
 * with the reversed name and is found by one lookup: searching the field itself would cost a large
 * group the square of its size.
 */
class Pieces
{
public:
    void add(std::string const& field)
    {
        std::string::size_type start = 0;
        for (std::string::size_type comma = field.find(','); comma != std::string::npos;
             comma = field.find(',', start)) {
            reversed_.emplace(field.rend() - static_cast<std::ptrdiff_t>(comma),
                              field.rend() - static_cast<std::ptrdiff_t>(start));
            start = comma + 1;
        }
    }

    bool endIn(std::string const& name) const
    {
        std::string const key(name.rbegin(), name.rend());
        auto const candidate = reversed_.lower_bound(key);
        return candidate != reversed_.end() && candidate->compare(0, key.size(), key) == 0;
    }

private:
    std::set<std::string> reversed_;
};

} // namespace

PrimaryMembers::PrimaryMembers()
{
    files::File const file("/etc/passwd", "ro");
    if (!file.stream())
        return;
    while (passwd const* account = fgetpwent(file.stream()))
        byGroup_[account->pw_gid].append(account->pw_name).append(",");
}

std::string PrimaryMembers::of(unsigned int groupId) const
{
    auto const found = byGroup_.find(groupId);
    return found == byGroup_.end() ? std::string() : found->second;
}

std::string withMembers(std::string field, char const* const* members)
{
    Pieces pieces;
    pieces.add(field);
    for (; *members; ++members) {
        std::string const name = *members;
        std::string const entry = name + ",";
        bool const listed = name.find(',') == std::string::npos
                                ? pieces.endIn(name)
                                : field.find(entry) != std::string::npos;
        if (listed)
            continue;
        field += entry;
        pieces.add(entry);
    }
    if (field.size() > 1)
        field.pop_back();
    return field;
}

} // namespace NQ::GROUP_INFO
