#include "mihost/cli/check/Isolated.h"
#include "mihost/cli/check/Report.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/Range.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/CommandLocale.h"
#include "mihost/sandbox/Sandbox.h"

#include <algorithm>
#include <cstdlib>
#include <stdexcept>
#include <sys/stat.h>

namespace mihost
{

namespace
{

constexpr char textFormat[] = "text";
constexpr char tap[] = "tap";
constexpr char junit[] = "junit";

class CheckCommand : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("PLUGIN", plugin_,
                       "the file to check; by default the plug-in that mihost loads")
            ->type_name("FILE");
        choices_
            .restrict(app.add_option("--format", format_, "print the results in this format"),
                      {textFormat, tap, junit})
            ->capture_default_str();
        app.add_option("--rounds", rounds_,
                       "start and stop the plug-in N times when looking for leaks")
            ->type_name("N")
            ->check(wholeBetween(1, 1000))
            ->capture_default_str();
        app.add_option("--time-limit", timeLimit_, "stop each group of checks after S seconds")
            ->type_name("S")
            ->check(wholeBetween(1, 86400))
            ->capture_default_str();
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        refuseWhatDoesNotFit(session.options());
        checks::Results const results = runAll(session.options());
        write(results, session);
        if (std::any_of(results.begin(), results.end(),
                        [](checks::Result const& result) { return result.failed(); }))
            session.endWith(Failed);
    }

private:
    void refuseWhatDoesNotFit(Options const& options) const
    {
        if (options.format != Format::TableText && format_ != textFormat)
            throw Failure(BadUsage, "check: --format and -o cannot be combined");
        if (!options.trace.empty())
            throw Failure(BadUsage, "check: --trace is not supported (leave it out)");
    }

    checks::Results runAll(Options const& options) const
    {
        if (!inSandbox())
            throw std::logic_error("plug-ins are checked in a sandbox only");
        // As for a plug-in that is loaded for use; see Session::plugin.
        umask(077);
        useCommandLocale();
        checks::Settings const settings{pluginFile(plugin_.empty() ? options.plugin : plugin_),
                                        rounds_, std::chrono::seconds(timeLimit_)};
        checks::Results all;
        for (checks::Scenario const& scenario : checks::scenarios())
            for (checks::Result const& result : checks::runIsolated(scenario, settings))
                all.push_back(result);
        return all;
    }

    void write(checks::Results const& results, Session& session) const
    {
        if (session.options().format != Format::TableText)
            session.out().table(checks::tableOf(results));
        else if (format_ == tap)
            session.out().write(checks::tapText(results));
        else if (format_ == junit)
            session.out().write(checks::junitText(results));
        else
            checks::writeText(results, session.out());
    }

    std::string plugin_;
    std::string format_ = textFormat;
    unsigned int rounds_ = 5;
    unsigned int timeLimit_ = 120; // seconds
};

} // namespace

CommandRow const commandRows::check{
    "check",
    "check a plug-in from the host's side, in a sandbox",
    newCommand<CheckCommand>,
    {
        {"mihost check --rounds 1", "check the installed plug-in"},
        {"mihost check --rounds 1 --format tap", "print the results for a test harness"},
    },
    CommandRow::NotInShell | CommandRow::AlwaysSandbox,
};

} // namespace mihost
