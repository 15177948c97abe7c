#include "host/Methods.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/GroupView.h"
#include "mihost/cli/commands/TaskCommand.h"

namespace mihost
{

namespace
{

constexpr TaskValue localGroup = {"GROUP", IC::parameter::localGroupName, "", "the group's name"};
constexpr TaskValue memberOfGroup = {"USER", IC::parameter::domainAndMember, "",
                                     "login name of the member"};

std::vector<Task> const groupTasks = {
    {
        "add",
        "add a group",
        IC::method::localGroupAdd,
        {{"NAME", IC::parameter::groupName, "", "name of the new group"}},
        {
            {"mihost group add builders", "add a group"},
            {"mihost --json group add builders", "print what changed as JSON"},
        },
    },
    Task{
        "delete",
        "delete a group",
        IC::method::localGroupDel,
        {{"GROUP", IC::parameter::groupName, "", "the group's name"}},
        {
            {"mihost group delete staff", "delete after a prompt"},
            {"mihost --sandbox group delete staff -y", "try it in a sandbox"},
        },
    }
        .asking("delete the group {}"),
    {
        "add-member",
        "add a user to a group",
        IC::method::localGroupAddUser,
        {localGroup, memberOfGroup},
        {
            {"mihost group add-member staff jdoe", "make jdoe a member of staff"},
            {"mihost --sandbox group add-member staff jdoe", "try it in a sandbox"},
        },
    },
    {
        "remove-member",
        "remove a user from a group",
        IC::method::localGroupDelUser,
        {localGroup, memberOfGroup},
        {
            {"mihost group remove-member crew jdoe", "remove jdoe from crew"},
            {"mihost --json group remove-member crew jdoe", "print what changed as JSON"},
        },
    },
};

class GroupCommand : public TaskCommand
{
public:
    GroupCommand() : TaskCommand({"group", "GROUP", "the group to show", groupTasks, showGroup}) {}
};

} // namespace

CommandRow const commandRows::group{
    "group",
    "show or change a group",
    newCommand<GroupCommand>,
    {
        {"mihost group crew", "its id and members"},
        {"mihost group add-member staff jdoe", "add a member"},
    },
};

} // namespace mihost
