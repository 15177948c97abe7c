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

using OSINFO::Commands;
using OSINFO::Method;
using OSINFO::MethodKind;
using OSINFO::methods;
using OSINFO::Ran;

std::string programOf(Method const& method)
{
    // There useradd makes a group for each user unless told not to.
    bool const needsOption =
        method.kind == MethodKind::userAdd && FILES::canOpen("/etc/redhat-release");
    return needsOption ? std::string(method.program) + " -n" : method.program;
}

int runTools(OsInfo& info, Method const& method, std::vector<ParamInfo> const& params,
             char const* function)
{
    Commands commands;
    std::string complaint;
    if (!OSINFO::makeCommands(method, programOf(method), params, commands, complaint)) {
        if (!complaint.empty())
            LOG::write(methods, LOG::error, complaint, function);
        return 1;
    }
    bool const adding = method.kind == MethodKind::userAdd;
    Ran const main = OSINFO::runLogged(info, commands.main, params, function);
    bool const added = adding && main.output.find("rc=0") != std::string::npos;
    if (main.status != 0 && !OSINFO::isBenign(main.output) && !added)
        return main.status;
    if (commands.password)
        info.executePasswordEncryption(commands.password->data(), commands.user.data());
    if (!adding)
        return 0;
    Ran const aging = OSINFO::runLogged(info, commands.aging, params, function);
    return OSINFO::isAgingNotice(aging.output) ? 0 : aging.status;
}

} // namespace

bool OsInfo::setCreateUser(std::string methodAndParams)
{
    LOG::Scope const scope(methods, {"OsNode::setCreateUser"});
    std::string method;
    std::vector<ParamInfo> params;
    if (parseMethodAndParams(methodAndParams, method, params) != 0)
        return false;
    bool shadowing = false;
    return executeMethod(method, params, shadowing) == 0;
}

int OsInfo::executeMethod(std::string method, std::vector<ParamInfo> params, bool& shadowing)
{
    LOG::Scope const scope(methods, {"OsNode::executeMethod"});
    Method const* known = OSINFO::findMethod(method);
    if (!known) {
        LOG::write(methods, LOG::error, LOG::message("Unknown method: ", method));
        return 1;
    }
    switch (known->kind) {
    case MethodKind::getShadowing:
        shadowing = FILES::canOpen("/etc/shadow");
        return 0;
    case MethodKind::groupMembership:
        return groupMemberChanges(method, params) ? 1 : 0;
    default:
        return runTools(*this, *known, params, __func__);
    }
}

void OsInfo::executePasswordEncryption(char* password, char* user)
{
    LOG::Scope const scope(methods);
    if (*user == '\0') {
        // Without a name passwd would take the password for the caller's own account.
        LOG::write(methods, LOG::error, "No user name for the password");
        return;
    }
    OSINFO::run(*this, {"echo", password, "|", "/usr/bin/passwd", user, "--stdin"});
}

} // namespace NQ
