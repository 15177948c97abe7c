// The listing: who is reported, and their account data.

#include "host/make_string.h"
#include "sysdata/minMaxId.h"
#include "sysdata/userInfo_linux.h"
#include "sysdata/userInfo_log.h"
#include "sysdata/userInfo_parse.h"
#include "util/file.h"

#include <cstdio>
#include <cstring>
#include <optional>
#include <pwd.h>
#include <shadow.h>
#include <string>
#include <utility>

namespace NQ
{

namespace
{

using USER_INFO::unit;

constexpr std::size_t lineSize = 4096;

/** The two account files, open and with the account lock held by the object. */
class AccountFiles
{
public:
    AccountFiles() : passwd_("/etc/passwd", "ro")
    {
        if (!passwd_.stream())
            return;
        shadow_.emplace("/etc/shadow", "ro");
        lckpwdf();
    }

    ~AccountFiles()
    {
        if (passwd_.stream())
            ulckpwdf();
    }

    AccountFiles(AccountFiles const&) = delete;
    AccountFiles& operator=(AccountFiles const&) = delete;

    /** @return null at the end, and if an entry cannot be read */
    passwd const* nextAccount()
    {
        passwd* found = nullptr;
        if (!passwd_.stream() || fgetpwent_r(passwd_.stream(), &account_, accountLine_,
                                             sizeof accountLine_, &found) != 0)
            return nullptr;
        return &account_;
    }

    /**
     * The shadow entry of an account, searched from where the last search stopped. Contract: an
     * account that is missing uses the file up, and no later one is found.
     */
    spwd const* findShadow(char const* name)
    {
        spwd* found = nullptr;
        FILE* const stream = shadow_ ? shadow_->stream() : nullptr;
        while (stream &&
               fgetspent_r(stream, &ageing_, ageingLine_, sizeof ageingLine_, &found) == 0)
            if (std::strcmp(ageing_.sp_namp, name) == 0)
                return &ageing_;
        return nullptr;
    }

private:
    std::optional<files::File> shadow_; // opened only once the accounts are
    files::File passwd_;
    passwd account_{};
    spwd ageing_{};
    char accountLine_[lineSize] = "";
    char ageingLine_[lineSize] = "";
};

/** An empty field is -1, in the width of a long. */
unsigned long daysOf(long field)
{
    return field == -1 ? USER_INFO::never : static_cast<unsigned long>(field);
}

void setAgeing(userInfo& user, spwd const& entry)
{
    user.setUserPassword(make_string(entry.sp_pwdp));
    user.setLstPwdChg(daysOf(entry.sp_lstchg));
    user.setPwdMinDays(daysOf(entry.sp_min));
    user.setPwdMaxDays(daysOf(entry.sp_max));
    user.setPwdWarnDays(daysOf(entry.sp_warn));
    user.setPwdExpDays(daysOf(entry.sp_inact));
    user.setPwdInactDays(daysOf(entry.sp_expire));
    user.setPasswordHistoryDepth(0);
}

/** The number that the login service's rules allow; the last one in the file, 0 without one. */
long readMaxLoginFailures(files::WholeText& text, log::Scope const& scope)
{
    long failures = 0;
    std::string_view rules = text.read("/etc/pam.d/login");
    for (std::string line = USER_INFO::takeDenyLine(rules); !line.empty();
         line = USER_INFO::takeDenyLine(rules))
        if (USER_INFO::scanDeny(line, failures) == USER_INFO::Scan::invalid)
            scope.error("Invalid format: line = ", line);
    return failures;
}

} // namespace

void getUserInfo(std::vector<userInfo>& users)
{
    log::Scope const scope(unit);
    users.clear();
    AccountFiles files;
    files::WholeText rules;
    while (passwd const* account = files.nextAccount()) {
        if (!isReportedUser(account->pw_uid))
            continue;
        userInfo user(account->pw_name);
        user.setUserId(std::to_string(account->pw_uid));
        user.setGroupId(std::to_string(account->pw_gid));
        // An entry for a remote database has none of these texts.
        user.setUserFullName(make_string(account->pw_gecos));
        user.setUserHomeDir(make_string(account->pw_dir));
        user.setUserScriptPath(make_string(account->pw_shell));
        user.setUserAcctDisabled(false);
        if (spwd const* ageing = files.findShadow(account->pw_name))
            setAgeing(user, *ageing);
        user.setMaxLoginFailures(readMaxLoginFailures(rules, scope));
        users.push_back(std::move(user));
    }
}

} // namespace NQ
