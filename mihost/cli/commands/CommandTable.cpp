#include "mihost/cli/commands/makers.h"
#include "mihost/cli/input/Command.h"

namespace mihost
{

CommandTable const& commandTable()
{
    static CommandTable const rows = {
        {"tree", "show the tree, one line a node", commandMakers::tree},
        {"list", "show one kind of node as a table", commandMakers::list},
        {"get", "read properties of a node, live", commandMakers::get},
        {"set", "write one property of a node", commandMakers::set},
        {"call", "carry out an administration method", commandMakers::call},
        {"refresh", "build the user and group nodes anew", commandMakers::refresh},
        {"clear-log", "empty the system log", commandMakers::clearLog},
        {"power", "restart or halt the machine", commandMakers::power},
        {"watch", "print properties whenever they change", commandMakers::watch},
        {"shell", "run many commands on one loaded plug-in", commandMakers::shell, true},
        {"doctor", "tell what this machine lacks for a full tree", commandMakers::doctor},
        {"metrics", "print figures for Prometheus", commandMakers::metrics, true},
        {"check", "check a plug-in in a sandbox, as a host sees it", commandMakers::check, true,
         true},
        {"version", "show the versions of program, contract and plug-in", commandMakers::version},
        {"properties", "describe the properties of each kind of node", commandMakers::properties},
        {"methods", "describe the administration methods", commandMakers::methods},
    };
    return rows;
}

} // namespace mihost
