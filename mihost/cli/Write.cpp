#include "mihost/cli/Write.h"

#include "mihost/cli/AccountFiles.h"
#include "mihost/cli/CommandTap.h"
#include "mihost/cli/Failure.h"
#include "mihost/cli/Interrupts.h"
#include "mihost/cli/Lines.h"
#include "mihost/cli/SandboxChanges.h"
#include "mihost/cli/Say.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Sandbox.h"
#include "nodes/ids.h"

#include <filesystem>
#include <fmt/format.h>

namespace mihost
{

namespace
{

using commandTap::RunCommand;

struct Result {
    IC::Error error;
    std::vector<RunCommand> commands;
    AccountFiles accounts; // as they are afterwards
    std::vector<FileChange> changes;
    std::string complaints; // what the commands wrote to their standard error
};

Result perform(Write const& write, Secrets secrets)
{
    interrupts::Held const held;
    commandTap::Recording const recording;
    commandTap::takeStandardError();
    CopyState const before = CopyState::read();
    Result result{write.node.setProperty(write.property, write.value), {}, {}, {}, {}};
    for (RunCommand const& command : recording.commands())
        result.commands.push_back({withoutSecret(command.line, write.secret),
                                   withoutSecret(command.output, write.secret), command.status});
    result.accounts = readAccountFiles();
    result.changes =
        shownChanges(before.changesTo(CopyState::read()), std::filesystem::current_path(), secrets);
    result.complaints = withoutSecret(commandTap::takeStandardError(), write.secret);
    return result;
}

Json documentOf(Result const& result)
{
    Json document = toJson(result.error);
    if (!inSandbox())
        return document;
    Json commands = Json::array();
    for (RunCommand const& command : result.commands)
        commands.push_back({{"command", toJson(command.line)}, {"output", toJson(command.output)}});
    document["commands"] = commands;
    document["changes"] = toJson(result.changes);
    return document;
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

void writeText(Result const& result, Output& out)
{
    for (RunCommand const& command : result.commands) {
        out.line("ran  " + printable(command.line));
        for (std::string const& line : linesOf(command.output))
            out.line("     " + shown(line));
    }
    writeText(result.changes, out);
}

/**
 * What the last command that said anything said first: mostly why it failed. Empty where none did.
 */
std::string likelyReason(std::vector<RunCommand> const& commands)
{
    for (auto command = commands.rbegin(); command != commands.rend(); ++command)
        for (std::string const& line : linesOf(command->output))
            if (!line.empty() && line.rfind("rc=", 0) != 0)
                return line;
    return "";
}

void warnOfPlainPassword(AccountFiles const& accounts, std::string const& password)
{
    auto const shadow = accounts.find(shadowFile);
    if (password.empty() || shadow == accounts.end())
        return;
    for (std::string const& line : shadow->second) {
        std::size_t const first = line.find(':');
        std::size_t const second = line.find(':', first + 1);
        if (first != std::string::npos && line.substr(first + 1, second - first - 1) == password)
            say(fmt::format(
                "mihost: the password of '{}' now stands in {} as it is and opens nothing: "
                "/usr/bin/passwd here does not take passwords from a pipe; set it with "
                "passwd\n",
                printable(line.substr(0, first)), shadowFile));
    }
}

bool endsWord(char character)
{
    return std::string_view(" \t\n'\"`:").find(character) != std::string_view::npos;
}

} // namespace

std::string withoutSecret(std::string const& text, std::string const& secret)
{
    if (secret.empty())
        return text;
    std::string result;
    std::size_t start = 0;
    while (start <= text.size()) {
        std::size_t end = start;
        while (end < text.size() && !endsWord(text[end]))
            ++end;
        std::string const word = text.substr(start, end - start);
        result += word == secret ? "(hidden)" : word;
        if (end < text.size())
            result += text[end];
        start = end + 1;
    }
    return result;
}

void carryOut(Session& session, Write const& write)
{
    Result const result = perform(write, session.secrets());
    if (session.options().json)
        session.out().json(documentOf(result));
    else if (inSandbox())
        writeText(result, session.out());
    session.out().flush();
    for (std::string const& line : linesOf(result.complaints))
        say(fmt::format("mihost: a command said: {}\n", printable(line)));
    if (write.property == NODES::createUser)
        warnOfPlainPassword(result.accounts, write.secret);
    if (result.error.getStatus() == 0)
        return;
    std::string const reason = likelyReason(result.commands);
    throw Failure(PluginRefused,
                  fmt::format("the plug-in answered {}{}{}", static_cast<std::string>(result.error),
                              reason.empty() ? "" : "; a command said: ", reason));
}

} // namespace mihost
