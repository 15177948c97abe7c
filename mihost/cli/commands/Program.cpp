#include "mihost/cli/commands/Program.h"

#include "mihost/cli/accounts/LocalNames.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/CommandLine.h"
#include "mihost/cli/input/Remote.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/shell/BashCompletion.h"
#include "mihost/cli/shell/Completion.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Interrupts.h"

#include <cerrno>
#include <clocale>
#include <cstring>
#include <fmt/format.h>
#include <unistd.h>

namespace mihost
{

namespace
{

/** Runs the step and returns the exit code. */
template <class Step> int guarded(Step step)
{
    try {
        step();
        return Done;
    } catch (OutputClosed const&) {
        return Done;
    } catch (Failure const& failure) {
        tell(failure);
        return failure.code();
    } catch (std::exception const& error) { // no memory or no descriptor is left
        tell({Failed, error.what()});
        return Failed;
    }
}

/** A typed password must not be echoed, which needs terminals on both sides. */
RemoteTerminal remoteTerminal()
{
    if (isatty(STDIN_FILENO) != 1)
        return RemoteTerminal::None;
    return isatty(STDOUT_FILENO) == 1 ? RemoteTerminal::Use : RemoteTerminal::Ignore;
}

/** Replaces this program by ssh, with the same streams; its exit status becomes this one's. */
void runRemotely(std::string const& host, std::vector<std::string> const& words)
{
    auto const rest = withoutHost(words, host);
    auto command = remoteCommand(host, rest, remoteTerminal());
    std::vector<char*> arguments;
    arguments.reserve(command.size() + 1);
    for (std::string& word : command)
        arguments.push_back(word.data());
    arguments.push_back(nullptr);
    execvp(arguments[0], arguments.data());
    throw Failure(BadUsage, fmt::format("--host: cannot run ssh: {} (install openssh-client)",
                                        std::strerror(errno)));
}

int answer(std::string const& text)
{
    return guarded([&text] {
        Output out(stdout);
        out.write(text);
        out.flush();
    });
}

} // namespace

int runProgram(int argc, char** argv)
{
    if (argc > 1 && std::string_view(argv[1]) == "__complete")
        // Run by the shells' completion scripts. The words are not a complete command line.
        return answer(
            completionText(complete({argv + 2, argv + argc}, localNames, commandTable())));
    if (argc == 4 && std::string_view(argv[1]) == "__complete-bash")
        return answer(bashCompletionText(argv[2], argv[3], localNames, commandTable()));
    // The code set is the user's; everything else, dates and numbers, stays as the plug-in expects.
    std::setlocale(LC_CTYPE, "");
    interrupts::install();

    CommandLine line(commandTable());
    if (int const code = guarded([&] { line.parse({argv + 1, argv + argc}); }); code != Done)
        return code;
    if (!line.command())
        return answer(line.answer());
    if (std::string const& host = line.options().host; !host.empty())
        return guarded([&] { runRemotely(host, {argv + 1, argv + argc}); });
    std::unique_ptr<Session> session;
    int const run = guarded([&] {
        session = std::make_unique<Session>(line.options());
        line.command()->run(*session);
        Session::warnOfUnknown();
    });
    if (!session)
        return run;
    int const end = guarded([&] { session->finish(); });
    for (int const code : {run, end, static_cast<int>(session->exitCode())})
        if (code != Done)
            return code;
    return Done;
}

} // namespace mihost
