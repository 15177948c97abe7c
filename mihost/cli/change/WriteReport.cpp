#include "mihost/cli/change/WriteReport.h"

#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/TextFile.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Sandbox.h"

namespace mihost
{

namespace
{

using commandTap::RunCommand;

Json commandsToJson(std::vector<RunCommand> const& commands)
{
    Json list = Json::array();
    for (RunCommand const& command : commands)
        list.push_back({{"command", toJson(command.line)}, {"output", toJson(command.output)}});
    return list;
}

/** One line of a command's output; tabs stay, since they lay it out. */
std::string shown(std::string const& line)
{
    std::string text;
    std::size_t start = 0;
    for (std::size_t tab = 0; (tab = line.find('\t', start)) != std::string::npos; start = tab + 1)
        text += printable(line.substr(start, tab - start)) + '\t';
    return text + printable(line.substr(start));
}

} // namespace

Json toJson(WriteReport const& report)
{
    Json document;
    document["status"] = report.error.empty() ? static_cast<int>(Done) : Failed;
    document["changed"] = report.changed;
    document["changes"] = listToJson(report.changes);
    document["warnings"] = listToJson(report.warnings);
    if (!report.error.empty())
        document["error"] = toJson(report.error);
    if (inSandbox())
        document["commands"] = commandsToJson(report.commands);
    return document;
}

void writeText(WriteReport const& report, Output& out)
{
    for (RunCommand const& command : report.commands) {
        out.line("ran  " + printable(command.line));
        for (std::string const& line : linesOf(command.output))
            out.line("     " + shown(line));
    }
    writeText(report.changes, out);
}

} // namespace mihost
