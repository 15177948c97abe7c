#include "sysdata/minMaxId.h"

#include "util/file.h"

#include <cstdio>
#include <cstring>
#include <iterator>
#include <string>

namespace NQ
{

namespace
{

// Contract: one in the file ends it, too; a NUL does not.
constexpr char endMark = '\xFF';
constexpr std::size_t keyLength = 7;

} // namespace

minMaxId* minMaxId::pinstance = nullptr;

minMaxId* minMaxId::Instance()
{
    if (!pinstance)
        pinstance = new minMaxId;
    return pinstance;
}

minMaxId::minMaxId()
{
    files::WholeText file;
    std::string text(file.read("/etc/login.defs"));
    text += endMark;
    parse(text.c_str());
}

void minMaxId::parse(char const* text)
{
    struct Key {
        char const* name;
        unsigned int& value;
        bool found;
    };
    Key keys[] = {{"UID_MIN", minUserId_, false},
                  {"UID_MAX", maxUserId_, false},
                  {"GID_MAX", maxGroupId_, false},
                  {"GID_MIN", minGroupId_, false}};

    std::size_t found = 0;
    for (char const* line = text; *line != endMark;) {
        for (Key& key : keys) {
            if (std::strncmp(line, key.name, keyLength) != 0)
                continue;
            // One byte separates, whatever it is. A value that is not a number keeps the old one.
            std::sscanf(line + keyLength + 1, "%u", &key.value);
            found += key.found ? 0 : 1;
            key.found = true;
            break;
        }
        if (found == std::size(keys))
            return;
        while (*line != '\n' && *line != endMark)
            ++line;
        if (*line == '\n')
            ++line;
    }
}

unsigned int minMaxId::getMinUserId()
{
    return minUserId_;
}

unsigned int minMaxId::getMinGroupId()
{
    return minGroupId_;
}

unsigned int minMaxId::getMaxUserId()
{
    return maxUserId_;
}

unsigned int minMaxId::getMaxGroupId()
{
    return maxGroupId_;
}

// Contract: both bounds are queried for every id, 0 included.
bool isReportedUser(unsigned int uid)
{
    unsigned int const lowest = minMaxId::Instance()->getMinUserId();
    unsigned int const highest = minMaxId::Instance()->getMaxUserId();
    return uid == 0 || (uid >= lowest && uid <= highest);
}

bool isReportedGroup(unsigned int gid)
{
    unsigned int const lowest = minMaxId::Instance()->getMinGroupId();
    unsigned int const highest = minMaxId::Instance()->getMaxGroupId();
    return gid == 0 || (gid >= lowest && gid <= highest);
}

} // namespace NQ
