#include "sysdata/osInfo_run.h"

#include "sysdata/osInfo_log.h"
#include "util/file.h"

#include <cstdio>

namespace NQ
{

namespace
{

using os::bufferSize;
using os::methods;

} // namespace

os::Ran os::run(OsInfo& info, Arguments arguments)
{
    std::vector<char*> entries;
    for (std::string& argument : arguments)
        entries.push_back(argument.data());
    char end[] = "";
    entries.push_back(end);
    char output[bufferSize];
    int const status = info.executeCommand(entries.front(), entries.data(), output);
    return {status, output};
}

os::Ran os::runLogged(OsInfo& info, Arguments const& arguments,
                      std::vector<ParamInfo> const& params, log::Scope const& scope)
{
    Ran ran = run(info, arguments);
    scope.progress("outputBuffer: ", withoutPasswords(ran.output, params));
    return ran;
}

int OsInfo::executeCommand(char* program, char** arguments, char* output)
{
    log::Scope const scope(methods);
    output[0] = '\0';
    os::Arguments list{program};
    for (char** argument = arguments + 1; **argument != '\0'; ++argument)
        list.emplace_back(*argument);
    std::string const line = os::commandLine(list);
    if (line.size() >= bufferSize) {
        scope.error(os::tooLong, program);
        return 1;
    }
    FILE* pipe = popen(line.c_str(), "r");
    if (!pipe) {
        // The line itself may hold a password.
        scope.error("Cannot open process: ", program);
        return 1;
    }
    bool const any = files::readToEnd(pipe, output, bufferSize);
    pclose(pipe);
    return any ? 1 : 0;
}

} // namespace NQ
