#include "mihost/cli/commands/Program.h"

#include "mihost/cli/accounts/LocalNames.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/CommandLine.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/shell/BashCompletion.h"
#include "mihost/cli/shell/Completion.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Interrupts.h"

#include <clocale>

namespace mihost
{

namespace
{

/** Runs the step. What goes wrong becomes the exit code. */
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
        tell({PluginRefused, error.what()});
        return PluginRefused;
    }
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
        // What the completion scripts of shells run. Their words are no command line yet.
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
