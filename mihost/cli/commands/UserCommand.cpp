#include "host/Methods.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/TaskCommand.h"
#include "mihost/cli/commands/UserView.h"

namespace mihost
{

namespace
{

constexpr TaskValue account = {"USER", IC::parameter::userName, "", "login name"};
constexpr TaskValue minDays = {"--min-days", IC::parameter::daysMustKeepPassword, "N",
                               "set the minimum password age in days"};
constexpr TaskValue maxDays = {"--max-days", IC::parameter::daysMustChangePasswordAfter, "N",
                               "set the maximum password age in days"};
constexpr TaskValue warnDays = {"--warn-days", IC::parameter::daysWarnBeforePasswordExpire, "N",
                                "warn N days before the password expires"};
constexpr TaskValue inactiveDays = {"--inactive-days", IC::parameter::daysExpireAfter, "N",
                                    "disable the account N days after the password expires"};

std::vector<Task> const userTasks = {
    {
        "add",
        "add an account",
        IC::method::userAdd,
        {
            {"NAME", IC::parameter::userName, "", "login name of the new account"},
            {"--full-name", IC::parameter::comment, "FULL-NAME", "set the full name"},
            {"--home", IC::parameter::homeDir, "DIR", "set the home directory"},
            {"--shell", IC::parameter::scriptPath, "FILE", "set the login shell"},
            {"--password", IC::parameter::password, "",
             "set a password, read from a prompt or standard input; without one, login by password "
             "is disabled"},
            minDays,
            maxDays,
            warnDays,
            inactiveDays,
            {"--expires", IC::parameter::passwordExpirationDate, "DAY",
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
        IC::method::userDel,
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
        IC::method::userSetScriptPath,
        {account, {"SHELL", IC::parameter::scriptPath, "FILE", "absolute path of the shell"}},
        {
            {"mihost user set-shell jdoe /bin/bash", "set the shell"},
            {"mihost user set-shell jdoe /usr/sbin/nologin", "refuse logins"},
        },
    },
    {
        "set-home",
        "move an account's home directory",
        IC::method::userSetHomeDir,
        {account,
         {"HOME", IC::parameter::homeDir, "DIR", "absolute path; the files are moved there"}},
        {
            {"mihost user set-home jdoe /srv/jdoe", "move the directory"},
            {"mihost --sandbox user set-home jdoe /srv/jdoe", "show which files would move"},
        },
    },
    {
        "set-name",
        "set an account's full name",
        IC::method::userSetFullName,
        {account, {"FULL-NAME", IC::parameter::fullName, "", "full name"}},
        {
            {"mihost user set-name jdoe 'Jane Doe'", "set the full name"},
            {"mihost --json user set-name jdoe 'Jane Doe'", "print what changed as JSON"},
        },
    },
    {
        "set-password",
        "set an account's password, read from a prompt or standard input",
        IC::method::userSetPassword,
        {account, {"--password", IC::parameter::password, "", ""}},
        {
            {"mihost user set-password jdoe", "prompt for the password"},
            {"mihost user set-password jdoe --password-file /root/secret", "read it from a file"},
        },
    },
    {
        "expire",
        "set the day on which an account expires",
        IC::method::userSetAttrib,
        {account, {"DAY", IC::parameter::passwordExpirationDate, "", "YYYY-MM-DD or never"}},
        {
            {"mihost user expire jdoe 2030-12-31", "expire the account on that day"},
            {"mihost user expire jdoe never", "remove the expiry date"},
        },
    },
    Task{
        "age",
        "set an account's password ageing",
        IC::method::userSetAttrib,
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
