#include "mihost/cli/Program.h"

#include "mihost/cli/CommandLine.h"
#include "mihost/cli/Failure.h"
#include "mihost/cli/Interrupts.h"
#include "mihost/cli/Session.h"
#include "mihost/runtime/Text.h"

#include <clocale>
#include <fmt/format.h>

namespace mihost
{

namespace
{

/** Runs the step. What goes wrong is told on one line and becomes the exit code. */
template <class Step> int guarded(Step step)
{
    try {
        step();
        return Done;
    } catch (OutputClosed const&) {
        return Done;
    } catch (Failure const& failure) {
        fmt::print(stderr, "mihost: {}\n", printable(failure.what()));
        return failure.code();
    }
}

} // namespace

int runProgram(int argc, char** argv)
{
    // The code set is the user's; everything else, dates and numbers, stays as the plug-in expects.
    std::setlocale(LC_CTYPE, "");
    interrupts::install();

    CommandLine line;
    if (int const code = guarded([&] { line.parse(argc, argv); }); code != Done || !line.command())
        return code;
    std::unique_ptr<Session> session;
    int const run = guarded([&] {
        session = std::make_unique<Session>(line.options());
        line.command()->run(*session);
    });
    if (!session)
        return run;
    int const end = guarded([&] { session->finish(); });
    return run != Done ? run : end;
}

} // namespace mihost
