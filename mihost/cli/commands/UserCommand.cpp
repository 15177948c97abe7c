#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/TaskCommand.h"
#include "mihost/cli/commands/UserView.h"

namespace mihost
{

namespace
{

constexpr TaskValue account = {"USER", "UserName", "", "login name"};
constexpr TaskValue minDays = {"--min-days", "daysMustKeepPassword", "N",
                               "set the minimum password age in days"};
constexpr TaskValue maxDays = {"--max-days", "daysMustChangePasswordAfter", "N",
                               "set the maximum password age in days"};
constexpr TaskValue warnDays = {"--warn-days", "daysWarnBeforePasswordExpire", "N",
                                "warn N days before the password expires"};
constexpr TaskValue inactiveDays = {"--inactive-days", "daysExpireAfter", "N",
                                    "disable the account N days after the password expires"};

std::vector<Task> const userTasks = {
    {
        "add",
        "add an account",
        "UserAdd",
        {
            {"NAME", "UserName", "", "login name of the new account"},
            {"--full-name", "Comment", "FULL-NAME", "set the full name"},
            {"--home", "HomeDir", "DIR", "set the home directory"},
            {"--shell", "ScriptPath", "FILE", "set the login shell"},
            {"--password", "Password", "",
             "set a password, read from a prompt or standard input; without one, login by password "
             "is disabled"},
            minDays,
            maxDays,
            warnDays,
            inactiveDays,
            {"--expires", "passwordExpirationDate", "DAY",
             "expire the account on DAY, YYYY-MM-DD or never"},
        },
        {
            {"mihost user add asmith --full-name 'A. Smith' --shell /bin/bash",
             "an account without a password"},
            {"mihost user add asmith --password --max-days 90", "prompt for a password"},
        },
    },
    Task{
        "delete",
        "delete an account, keeping its home directory and mail",
        "UserDel",
        {account},
        {
            {"mihost user delete jdoe", "delete after a prompt"},
            {"mihost --sandbox user delete jdoe -y", "try it in a sandbox"},
        },
    }
        .asking("delete the account {}"),
    {
        "set-shell",
        "set an account's login shell",
        "UserSetScriptPath",
        {account, {"SHELL", "ScriptPath", "FILE", "absolute path of the shell"}},
        {
            {"mihost user set-shell jdoe /bin/bash", "set the shell"},
            {"mihost user set-shell jdoe /usr/sbin/nologin", "refuse logins"},
        },
    },
    {
        "set-home",
        "move an account's home directory",
        "UserSetHomeDir",
        {account, {"HOME", "HomeDir", "DIR", "absolute path; the files are moved there"}},
        {
            {"mihost user set-home jdoe /srv/jdoe", "move the directory"},
            {"mihost --sandbox user set-home jdoe /srv/jdoe", "show which files would move"},
        },
    },
    {
        "set-name",
        "set an account's full name",
        "UserSetFullName",
        {account, {"FULL-NAME", "FullName", "", "full name"}},
        {
            {"mihost user set-name jdoe 'Jane Doe'", "set the full name"},
            {"mihost --json user set-name jdoe 'Jane Doe'", "print what changed as JSON"},
        },
    },
    {
        "set-password",
        "set an account's password, read from a prompt or standard input",
        "UserSetPassword",
        {account, {"--password", "Password", "", ""}},
        {
            {"mihost user set-password jdoe", "prompt for the password"},
            {"mihost user set-password jdoe --password-file /root/secret", "read it from a file"},
        },
    },
    {
        "expire",
        "set the day on which an account expires",
        "UserSetAttrib",
        {account, {"DAY", "passwordExpirationDate", "", "YYYY-MM-DD or never"}},
        {
            {"mihost user expire jdoe 2030-12-31", "expire the account on that day"},
            {"mihost user expire jdoe never", "remove the expiry date"},
        },
    },
    Task{
        "age",
        "set an account's password ageing",
        "UserSetAttrib",
        {account, minDays, maxDays, warnDays, inactiveDays},
        {
            {"mihost user age jdoe --max-days 90 --warn-days 14",
             "require a new password every 90 days"},
            {"mihost user age jdoe --max-days 99999", "set no maximum password age"},
        },
    }
        .needingAnOption(),
};

class UserCommand : public TaskCommand
{
public:
    UserCommand() : TaskCommand({"user", "USER", "the account to show", userTasks, showUser}) {}
};

} // namespace

CommandRow const commandRows::user{
    "user",
    "show or change an account",
    newCommand<UserCommand>,
    {
        {"mihost user jdoe", "ids, groups, state and password ageing"},
        {"mihost user set-shell jdoe /bin/sh", "set the login shell"},
    },
};

} // namespace mihost
