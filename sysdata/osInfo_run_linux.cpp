#include "sysdata/osInfo_run.h"

#include "sysdata/osInfo_log.h"
#include "util/file.h"

#include <cstdio>

namespace NQ
{

namespace
{

using OSINFO::bufferSize;
using OSINFO::methods;

} // namespace

OSINFO::Ran OSINFO::run(OsInfo& info, Arguments arguments)
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

OSINFO::Ran OSINFO::runLogged(OsInfo& info, Arguments const& arguments,
                              std::vector<ParamInfo> const& params, char const* function)
{
    Ran ran = run(info, arguments);
    LOG::write(methods, LOG::progress,
               LOG::message("outputBuffer: ", withoutPasswords(ran.output, params)), function);
    return ran;
}

int OsInfo::executeCommand(char* program, char** arguments, char* output)
{
    LOG::Scope const scope(methods);
    output[0] = '\0';
    OSINFO::Arguments list{program};
    for (char** argument = arguments + 1; **argument != '\0'; ++argument)
        list.emplace_back(*argument);
    std::string const line = OSINFO::commandLine(list);
    if (line.size() >= bufferSize) {
        LOG::write(methods, LOG::error, OSINFO::tooLong(program));
        return 1;
    }
    FILE* pipe = popen(line.c_str(), "r");
    if (!pipe) {
        // The line itself may hold a password.
        LOG::write(methods, LOG::error, LOG::message("Cannot open process: ", program));
        return 1;
    }
    bool const any = FILES::readToEnd(pipe, output, bufferSize);
    pclose(pipe);
    return any ? 1 : 0;
}

} // namespace NQ
