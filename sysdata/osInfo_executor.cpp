// Administration methods: mapped to the account tools, run and judged.

#include "sysdata/osInfo_commands.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/osInfo_log.h"
#include "sysdata/osInfo_run.h"
#include "util/file.h"

namespace NQ
{

namespace
{

using os::Commands;
using os::Method;
using os::MethodKind;
using os::methods;
using os::Ran;

std::string programOf(Method const& method)
{
    // On these systems, useradd without this option creates a group for each user.
    bool const needsOption =
        method.kind == MethodKind::userAdd && files::canOpen("/etc/redhat-release");
    return needsOption ? std::string(method.program) + " -n" : method.program;
}

int runTools(OsInfo& info, Method const& method, std::vector<ParamInfo> const& params,
             log::Scope const& scope)
{
    Commands commands;
    os::Complaint complaint;
    if (!os::makeCommands(method, programOf(method), params, commands, complaint)) {
        if (complaint.text)
            scope.error(complaint.text, complaint.about);
        return 1;
    }
    bool const adding = method.kind == MethodKind::userAdd;
    Ran const main = os::runLogged(info, commands.main, params, scope);
    bool const added = adding && main.output.find("rc=0") != std::string::npos;
    if (main.status != 0 && !os::isBenign(main.output) && !added)
        return main.status;
    if (commands.password)
        info.executePasswordEncryption(commands.password->data(), commands.user.data());
    if (!adding)
        return 0;
    Ran const aging = os::runLogged(info, commands.aging, params, scope);
    return os::isAgingNotice(aging.output) ? 0 : aging.status;
}

} // namespace

bool OsInfo::setCreateUser(std::string methodAndParams)
{
    log::Scope const scope(methods, {"OsNode::setCreateUser"});
    std::string method;
    std::vector<ParamInfo> params;
    if (parseMethodAndParams(methodAndParams, method, params) != 0)
        return false;
    bool shadowing = false;
    return executeMethod(method, params, shadowing) == 0;
}

int OsInfo::executeMethod(std::string method, std::vector<ParamInfo> params, bool& shadowing)
{
    log::Scope const scope(methods, {"OsNode::executeMethod"});
    Method const* known = os::findMethod(method);
    if (!known) {
        scope.error("Unknown method: ", method);
        return 1;
    }
    switch (known->kind) {
    case MethodKind::getShadowing:
        shadowing = files::canOpen("/etc/shadow");
        return 0;
    case MethodKind::groupMembership:
        return groupMemberChanges(method, params) ? 1 : 0;
    default:
        return runTools(*this, *known, params, scope);
    }
}

void OsInfo::executePasswordEncryption(char* password, char* user)
{
    log::Scope const scope(methods);
    if (*user == '\0') {
        // Without a name, passwd would change the caller's own password.
        scope.error("No user name for the password");
        return;
    }
    os::run(*this, {"echo", password, "|", "/usr/bin/passwd", user, "--stdin"});
}

} // namespace NQ
