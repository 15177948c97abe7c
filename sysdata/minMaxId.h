#ifndef SYSDATA_MINMAXID_H
#define SYSDATA_MINMAXID_H

#include "util/internal.h"

namespace NQ
{

/**
 * The ranges of ordinary user and group ids, both ends included, as /etc/login.defs sets them.
 *
 * Read once per process and never again. A key that is missing counts as 0, and so does every key
 * when the file cannot be read. Silent: it writes nothing to the log.
 */
class minMaxId
{
public:
    /** The one instance, made on first use and never freed. Not locked. */
    static minMaxId* Instance();

    minMaxId();

    unsigned int getMinUserId();
    unsigned int getMinGroupId();
    unsigned int getMaxUserId();
    unsigned int getMaxGroupId();

private:
    static minMaxId* pinstance;

    /** @param text  the file's bytes, followed by the end mark 0xFF and a NUL */
    MI_INTERNAL void parse(char const* text);

    unsigned int minUserId_ = 0;
    unsigned int minGroupId_ = 0;
    unsigned int maxUserId_ = 0;
    unsigned int maxGroupId_ = 0;
};

/** Whether the plug-in reports this account: an ordinary one, or one with id 0. */
MI_INTERNAL bool isReportedUser(unsigned int uid);

/** As isReportedUser, for groups. */
MI_INTERNAL bool isReportedGroup(unsigned int gid);

} // namespace NQ

#endif
