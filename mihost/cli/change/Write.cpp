#include "mihost/cli/change/Write.h"

#include "mihost/cli/change/AccountChanges.h"
#include "mihost/cli/change/SandboxChanges.h"
#include "mihost/cli/change/WriteReport.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/plugin/Redaction.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/SignalBlock.h"
#include "mihost/cli/system/Stderr.h"
#include "mihost/cli/system/TextFile.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Sandbox.h"

#include <algorithm>
#include <filesystem>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <sys/wait.h>

namespace mihost
{

namespace
{

using commandTap::RunCommand;

/** The state after the plug-in carried out a write. */
struct Result {
    IC::Error error;
    std::vector<RunCommand> commands;
    bool accountsDiffer;
    std::vector<FileChange> changes;
    std::vector<std::string> before; // what the expectations found
    std::vector<std::string> after;
    std::vector<std::string> complaints; // lines that commands wrote to their standard error
};

std::vector<std::string> findings(std::vector<Expectation> const& expectations)
{
    std::vector<std::string> all;
    all.reserve(expectations.size());
    for (Expectation const& expectation : expectations)
        all.push_back(expectation.actual());
    return all;
}

Result perform(Write const& write, Secrets secrets)
{
    SignalBlock const held;
    RedactingSink::Hiding const hiding(write.secrets);
    std::vector<std::string> const foundBefore = findings(write.expectations);
    AccountFiles const accounts = readAccountFiles();
    CopyState const copy = CopyState::read();
    commandTap::takeStandardError();
    commandTap::Recording const recording;
    Result result{
        write.node.setProperty(write.property, write.value), {}, false, {}, foundBefore, {}, {}};
    for (RunCommand const& command : recording.commands())
        result.commands.push_back({withoutSecrets(command.line, write.secrets),
                                   withoutSecrets(command.output, write.secrets), command.status});
    result.complaints = linesOf(withoutSecrets(commandTap::takeStandardError(), write.secrets));
    result.changes = changesBetween(accounts, readAccountFiles(), secrets);
    result.accountsDiffer = !result.changes.empty();
    if (inSandbox()) // in a sandbox, where every file can be compared
        result.changes = shownChanges(copy.changesTo(CopyState::read()),
                                      std::filesystem::current_path(), secrets);
    result.after = findings(write.expectations);
    return result;
}

constexpr std::string_view statusMark = "rc="; // the plug-in has useradd's exit status printed so

/** @return what a command printed, without the status line */
std::vector<std::string> wordsOf(RunCommand const& command)
{
    std::vector<std::string> lines = linesOf(command.output);
    lines.erase(std::remove_if(lines.begin(), lines.end(),
                               [](std::string const& line) {
                                   return line.empty() || line.rfind(statusMark, 0) == 0;
                               }),
                lines.end());
    return lines;
}

bool hasFailed(RunCommand const& command)
{
    if (command.status != 0)
        return true;
    std::vector<std::string> const lines = linesOf(command.output);
    if (lines.empty() || lines.back().rfind(statusMark, 0) != 0)
        return false;
    return parseDecimal(std::string_view(lines.back()).substr(statusMark.size())) != 0U;
}

/**
 * The plug-in passes every password to passwd, even one that fails; the password is verified as an
 * expectation.
 */
bool isPasswordOffer(RunCommand const& command)
{
    return command.line.find(" | /usr/bin/passwd ") != std::string::npos;
}

/** Whether what the command printed is an answer to the plug-in rather than a complaint. */
bool isAnswer(RunCommand const& command)
{
    static constexpr std::string_view queries[] = {"/usr/bin/id ", "chage -l "};
    bool const isQuery =
        std::any_of(std::begin(queries), std::end(queries), [&command](std::string_view query) {
            return command.line.compare(0, query.size(), query) == 0;
        });
    return isPasswordOffer(command) || (isQuery && command.status == 0);
}

/** @return what useradd printed although it succeeded; any other tool's output fails a call */
std::vector<std::string> remarksOf(Result const& result)
{
    std::vector<std::string> remarks;
    for (RunCommand const& command : result.commands)
        if (command.line.find("/usr/sbin/useradd ") == 0)
            for (std::string const& line : wordsOf(command))
                remarks.push_back(line);
    return remarks;
}

/** @return the first line of the last command that printed an error, usually why it failed */
std::string lastWords(Result const& result)
{
    for (auto command = result.commands.rbegin(); command != result.commands.rend(); ++command)
        if (auto const words = wordsOf(*command); !isAnswer(*command) && !words.empty())
            return words.front();
    return result.complaints.empty() ? "" : result.complaints.front();
}

std::string statusText(int status)
{
    return WIFEXITED(status) ? fmt::format("exit status {}", WEXITSTATUS(status))
                             : fmt::format("signal {}", WTERMSIG(status));
}

/** The first expectation that does not hold; empty if all do. */
std::string unmet(Write const& write, Result const& result)
{
    for (std::size_t at = 0; at < write.expectations.size(); ++at) {
        Expectation const& expectation = write.expectations[at];
        if (result.after[at] != expectation.wanted)
            return fmt::format("{} is {}, not {}", expectation.subject, result.after[at],
                               expectation.wanted);
    }
    return "";
}

/** The first command that failed; empty for none. */
std::string failedCommand(Result const& result)
{
    for (RunCommand const& command : result.commands)
        if (hasFailed(command) && !isPasswordOffer(command))
            return fmt::format("a command failed: '{}', {}", command.line,
                               statusText(command.status));
    return "";
}

bool ranTool(Write const& write, Result const& result)
{
    return std::any_of(result.commands.begin(), result.commands.end(), [&write](auto const& each) {
        return each.line.compare(0, write.tool.size(), write.tool) == 0;
    });
}

bool isChanged(Write const& write, Result const& result, bool hasFailed)
{
    bool const isToolsChange = !write.tool.empty() && !hasFailed;
    return write.acts && (result.accountsDiffer || result.before != result.after || isToolsChange);
}

/** @return why the write failed, without the commands' output; empty if it did not */
std::string problemOf(Write const& write, Result const& result)
{
    std::string failed = failedCommand(result);
    std::string missed = unmet(write, result);
    // The plug-in also fails a call if an account tool prints a remark, such as "no changes".
    bool const isAsAsked = !write.expectations.empty() && missed.empty() && failed.empty() &&
                           !result.commands.empty() && !isChanged(write, result, false);
    if (result.error.getStatus() != 0)
        return isAsAsked
                   ? ""
                   : fmt::format("the plug-in returned {}", static_cast<std::string>(result.error));
    if (!missed.empty())
        return missed;
    if (!write.tool.empty() && !ranTool(write, result))
        return fmt::format("{} was not started", write.tool);
    return failed;
}

WriteReport judged(Write const& write, Result const& result)
{
    std::string problem = problemOf(write, result);
    WriteReport report{"", isChanged(write, result, !problem.empty()), result.changes,
                       write.warnings, result.commands};
    std::vector<std::string> said = result.complaints;
    if (problem.empty()) {
        std::vector<std::string> const remarks = remarksOf(result);
        said.insert(said.end(), remarks.begin(), remarks.end());
    } else {
        std::string const words = lastWords(result);
        if (!words.empty())
            problem += "; a command printed: " + words;
        report.error = problem;
        said.erase(std::remove(said.begin(), said.end(), words), said.end());
    }
    for (std::string const& line : said)
        report.warnings.push_back("a command printed: " + line);
    return report;
}

/** Warns that the machine already was in the requested state. */
void tellUnchanged(Write const& write)
{
    std::vector<std::string> facts;
    facts.reserve(write.expectations.size());
    for (Expectation const& expectation : write.expectations)
        facts.push_back(fmt::format("{} is already {}", expectation.subject, expectation.wanted));
    warn(fmt::format("nothing changed: {}", fmt::join(facts, ", ")));
}

} // namespace

void carryOut(Session& session, Write const& write)
{
    for (std::string const& warning : write.warnings)
        warn(warning);
    Result const result = perform(write, session.secrets());
    WriteReport const report = judged(write, result);
    if (session.out().takesDocuments())
        session.out().json(toJson(report));
    else if (inSandbox())
        writeText(report, session.out());
    session.out().flush();
    for (std::size_t at = write.warnings.size(); at < report.warnings.size(); ++at)
        warn(report.warnings[at]);
    if (!report.error.empty())
        throw Failure(Failed, fmt::format("{}: {}", write.what, report.error));
    bool const isUnchanged = write.acts && !report.changed && !write.expectations.empty();
    if (isUnchanged && !session.out().takesDocuments())
        tellUnchanged(write);
}

} // namespace mihost
