#include "sysdata/groupInfo_linux.h"

#include "sysdata/groupInfo_members.h"
#include "sysdata/minMaxId.h"
#include "util/MutexLock.h"
#include "util/log.h"
#include "util/textTools.h"

#include <atomic>
#include <grp.h>
#include <thread>
#include <utility>

namespace NQ
{

std::string loggerGroupInfo = "Veltrix.IC.MI.OsSwMI.GroupInfo";

namespace
{

log::Unit const unit{loggerGroupInfo, "groupInfo_linux"};

/** The group database, read from its start; closed by the destructor. */
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

/**
 * The primary members that a listing reads once for all of its groups: reading /etc/passwd again
 * for each group would cost the product of groups and accounts. setGroupMembers finds them here,
 * but only when the listing's own thread calls it.
 */
class SharedPrimaryMembers
{
public:
    /** At most one exists at a time: the listing's mutex is held. */
    SharedPrimaryMembers()
    {
        shared = &primary_;
        owner = std::this_thread::get_id();
    }
    ~SharedPrimaryMembers()
    {
        owner = std::thread::id();
    }
    SharedPrimaryMembers(SharedPrimaryMembers const&) = delete;
    SharedPrimaryMembers& operator=(SharedPrimaryMembers const&) = delete;

    /** The primary members of a group, read from /etc/passwd unless this thread is listing. */
    static std::string of(unsigned int groupId)
    {
        bool const listing = owner.load() == std::this_thread::get_id();
        return listing ? shared->of(groupId) : GROUP_INFO::PrimaryMembers().of(groupId);
    }

private:
    static inline std::atomic<std::thread::id> owner;
    static inline GROUP_INFO::PrimaryMembers const* shared = nullptr; // used only by the owner

    GROUP_INFO::PrimaryMembers const primary_;
};

} // namespace

groupInfo::groupInfo() = default;

groupInfo::groupInfo(std::string name) : name_(std::move(name)) {}

std::string groupInfo::getGroupName()
{
    log::Scope const scope(unit);
    return name_;
}

unsigned int groupInfo::getGroupId()
{
    log::Scope const scope(unit);
    return groupId_;
}

void groupInfo::setGroupId(unsigned int groupId)
{
    log::Scope const scope(unit);
    groupId_ = groupId;
}

void groupInfo::setGroupMembers(char** members)
{
    log::Scope const scope(unit);
    members_ = GROUP_INFO::withMembers(SharedPrimaryMembers::of(groupId_), members);
}

std::vector<std::string> groupInfo::getGroupMembers()
{
    log::Scope const scope(unit);
    std::vector<std::string> members;
    Tokenize(members_, members, ",");
    return members;
}

void groupInfo::Tokenize(std::string const& text, std::vector<std::string>& tokens,
                         std::string const& delimiters)
{
    log::Scope const scope(unit);
    for (std::string& token : text::split(text, delimiters)) {
        tokens.push_back(std::move(token));
        scope.progress("str.substr(lastPos, pos - lastPos) = ", tokens.back());
    }
}

int getGroupInfo(std::vector<groupInfo>& groups)
{
    log::Scope const scope(unit);
    static Mutex mutex;
    groups.clear();
    MutexLock lock(mutex);
    {
        GroupDatabase database;
        SharedPrimaryMembers const primary;
        while (group const* entry = database.next()) {
            if (!isReportedGroup(entry->gr_gid))
                continue;
            groupInfo found(entry->gr_name);
            found.setGroupId(entry->gr_gid);
            found.setGroupMembers(entry->gr_mem);
            groups.push_back(std::move(found));
        }
    }
    return lock.release();
}

} // namespace NQ
