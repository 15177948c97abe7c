#ifndef SYSDATA_GROUPINFO_LINUX_H
#define SYSDATA_GROUPINFO_LINUX_H

#include <string>
#include <vector>

namespace NQ
{

/** Logger category of this source unit. */
extern std::string loggerGroupInfo;

/** One local group as of its listing. */
class groupInfo
{
public:
    groupInfo();
    groupInfo(std::string name);

    std::string getGroupName();

    unsigned int getGroupId();
    void setGroupId(unsigned int groupId);

    /**
     * Sets the members: first those whose primary group it is, in the order of /etc/passwd, then
     * the given ones. The group id must have been set.
     *
     * Contract: a given name is left out when a listed one ends in it, so bob is lost after xbob.
     *
     * @param members  login names, ended by a null pointer
     */
    void setGroupMembers(char** members);

    std::vector<std::string> getGroupMembers();

    /** Appends every maximal run of characters of the text that holds no delimiter. */
    void Tokenize(std::string const& text, std::vector<std::string>& tokens,
                  std::string const& delimiters);

private:
    std::string name_;
    std::string members_; // joined by ","
    unsigned int groupId_ = 0;
};

/**
 * Lists the ordinary groups and those with GID 0, in the order of the group database.
 *
 * The list is emptied first. Listings wait for each other: the database has one cursor for the
 * whole process.
 *
 * @return what the last unlocking returned, 0 for success
 */
int getGroupInfo(std::vector<groupInfo>& groups);

} // namespace NQ

#endif
