#include "mihost/cli/plugin/Session.h"

#include "mihost/cli/output/Document.h"
#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/cli/plugin/CommandGuard.h"
#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/plugin/Progress.h"
#include "mihost/cli/system/CommandLocale.h"
#include "mihost/cli/system/Privilege.h"
#include "mihost/cli/system/Stderr.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Sandbox.h"

#include <cstdlib>
#include <fmt/format.h>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace mihost
{

namespace
{

void goIntoSandbox(std::string const& overlay)
{
    auto const reason = enterSandbox(overlay);
    if (!reason)
        return;
    bool const isLimitedRoot = geteuid() == 0 && !hasCapability(CAP_SYS_ADMIN);
    throw Failure(BadUsage, fmt::format("creating the sandbox: {}{}", *reason,
                                        isLimitedRoot ? " (root lacks CAP_SYS_ADMIN: grant it "
                                                        "to this container or service)"
                                                      : ""));
}

} // namespace

Session::Session(Options const& options) : out_(stdout), pluginFile_(pluginFile(options.plugin))
{
    setOptions(options);
    if (!options_.trace.empty()) {
        trace_ = std::make_unique<Trace>(options_.trace);
        traceSink_ = std::make_unique<RedactingSink>(trace_->sink());
        sinks_.add(*traceSink_);
    }
    // The trace is already open, so it is written on the real machine. The plug-in's path is
    // absolute.
    if (options_.sandbox)
        goIntoSandbox(options_.overlay);
}

void Session::finish()
{
    plugin_.reset();
    directory_.reset();
    out_.flush();
    if (options_.timing && !timing_.rows().empty())
        writeStderr(timingReport());
    if (trace_)
        trace_->finish();
}

std::string Session::timingReport() const
{
    std::vector<Accelerator::Row> answers;
    if (accelerator_)
        answers = accelerator_->rows();
    if (!isDocument(options_.format))
        return timingText(timing_.rows()) + answersText(answers);
    Json report = toJson(timing_.rows());
    if (accelerator_)
        report["answers"] = toJson(answers);
    return documentText(report, options_.format);
}

Plugin& Session::plugin()
{
    if (!plugin_) {
        umask(077); // for what the plug-in and its commands write
        directory_ = std::make_unique<PrivateDirectory>();
        // The plug-in scans what commands print in English. It reads LANG itself, which stays.
        useCommandLocale();
        commandTap::setGuard(mayRun);
        timing_.begin("load");
        if (!options_.noAccel)
            accelerator_ = std::make_unique<Accelerator>();
        plugin_ = std::make_unique<Plugin>(pluginFile_);
        timing_.end();
    }
    return *plugin_;
}

void Session::start()
{
    std::optional<Progress> progress;
    std::vector<PhaseListener*> listeners;
    if (options_.timing)
        listeners.push_back(&timing_);
    if (!options_.quiet && takesControls(STDERR_FILENO)) {
        progress.emplace();
        listeners.push_back(&*progress);
        sinks_.add(*progress);
    }
    PhaseSink phaseSink(listeners);
    if (!listeners.empty())
        sinks_.add(phaseSink);
    plugin_->start();
    sinks_.remove(phaseSink);
    if (progress)
        sinks_.remove(*progress);
}

std::vector<IC::MutableNode*> Session::nodes()
{
    if (!plugin().started())
        start();
    return nodesOf(plugin_->interface());
}

IC::MutableNode& Session::node(std::string const& address)
{
    return findNode(nodes(), address);
}

void Session::endWith(ExitCode code)
{
    if (exitCode_ == Done)
        exitCode_ = code;
}

std::string Session::askSecret(std::string const& name) const
{
    if (scripted_)
        throw Failure(BadUsage,
                      fmt::format("{} cannot be read from standard input, which is the script "
                                  "(write it in the script)",
                                  name));
    return terminal::readSecret(name);
}

void Session::confirm(std::string const& command, std::string const& what) const
{
    if (options_.yes)
        return;
    if (!terminal::canAsk())
        throw Failure(BadUsage, fmt::format("{}: not a terminal (add --yes to {})", command, what));
    if (!terminal::confirm(printable(fmt::format("Really {}?", what))))
        throw Failure(BadUsage, fmt::format("{}: not confirmed, so nothing was changed", command));
}

void Session::warnOfUnknown()
{
    if (std::string const warning = takeUnknownWarning(); !warning.empty())
        warn(warning);
}

} // namespace mihost
