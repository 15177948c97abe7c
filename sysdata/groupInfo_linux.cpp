#include "sysdata/groupInfo_linux.h"

#include "sysdata/groupInfo_members.h"
#include "sysdata/minMaxId.h"
#include "util/MutexLock.h"
#include "util/log.h"
#include "util/text.h"

#include <grp.h>
#include <utility>

namespace NQ
{

std::string loggerGroupInfo = "Veltrix.IC.MI.OsSwMI.GroupInfo";

namespace
{

LOG::Unit const unit{loggerGroupInfo, "groupInfo_linux"};

/** The group database, read from its start; closed when the object goes. */
class GroupDatabase
{
public:
    GroupDatabase()
    {
        setgrent();
    }
    ~GroupDatabase()
    {
        endgrent();
    }
    GroupDatabase(GroupDatabase const&) = delete;
    GroupDatabase& operator=(GroupDatabase const&) = delete;

    /** @return null at the end */
    group const* next()
    {
        return getgrent();
    }
};

} // namespace

groupInfo::groupInfo() = default;

groupInfo::groupInfo(std::string name) : name_(std::move(name)) {}

std::string groupInfo::getGroupName()
{
    LOG::Scope const scope(unit);
    return name_;
}

unsigned int groupInfo::getGroupId()
{
    LOG::Scope const scope(unit);
    return groupId_;
}

void groupInfo::setGroupId(unsigned int groupId)
{
    LOG::Scope const scope(unit);
    groupId_ = groupId;
}

void groupInfo::setGroupMembers(char** members)
{
    LOG::Scope const scope(unit);
    members_ = GROUP_INFO::withMembers(GROUP_INFO::PrimaryMembers().of(groupId_), members);
}

void groupInfo::setGroupMembers(char** members, GROUP_INFO::PrimaryMembers const& primary)
{
    LOG::Scope const scope(unit);
    members_ = GROUP_INFO::withMembers(primary.of(groupId_), members);
}

std::vector<std::string> groupInfo::getGroupMembers()
{
    LOG::Scope const scope(unit);
    std::vector<std::string> members;
    Tokenize(members_, members, ",");
    return members;
}

void groupInfo::Tokenize(std::string const& text, std::vector<std::string>& tokens,
                         std::string const& delimiters)
{
    LOG::Scope const scope(unit);
    for (std::string& token : TEXT::split(text, delimiters)) {
        tokens.push_back(std::move(token));
        LOG::write(unit, LOG::progress,
                   LOG::message("str.substr(lastPos, pos - lastPos) = ", tokens.back()));
    }
}

int getGroupInfo(std::vector<groupInfo>& groups)
{
    LOG::Scope const scope(unit);
    static Mutex mutex;
    groups.clear();
    MutexLock lock(mutex);
    {
        GroupDatabase database;
        // The members of every group come out of one reading of /etc/passwd: reading it again for
        // each group would cost the product of groups and accounts.
        GROUP_INFO::PrimaryMembers const primary;
        while (group const* entry = database.next()) {
            if (!isReportedGroup(entry->gr_gid))
                continue;
            groupInfo found(entry->gr_name);
            found.setGroupId(entry->gr_gid);
            found.setGroupMembers(entry->gr_mem, primary);
            groups.push_back(std::move(found));
        }
    }
    return lock.release();
}

} // namespace NQ
