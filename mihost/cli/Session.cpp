#include "mihost/cli/Session.h"

#include "mihost/cli/Failure.h"
#include "mihost/sandbox/Sandbox.h"

#include <cstdlib>
#include <fmt/format.h>
#include <sys/stat.h>
#include <utility>

namespace mihost
{

namespace
{

void goIntoSandbox(std::string const& overlay)
{
    if (auto const reason = enterSandbox({overlay}))
        throw Failure(BadUsage, fmt::format("no sandbox, so nothing was run: {}", *reason));
}

} // namespace

Session::Session(Options options)
    : options_(std::move(options)), out_(stdout), pluginFile_(pluginFile(options_.plugin))
{
    if (!options_.trace.empty())
        trace_ = std::make_unique<Trace>(options_.trace);
    // The trace stays the machine's own: it is open by now. The plug-in's file has its full path.
    if (options_.sandbox)
        goIntoSandbox(options_.overlay);
}

void Session::finish()
{
    plugin_.reset();
    directory_.reset();
    out_.flush();
    if (trace_)
        trace_->finish();
}

Plugin& Session::library()
{
    if (!plugin_) {
        umask(077); // for what the plug-in and its commands write
        directory_ = std::make_unique<PrivateDirectory>();
        // The plug-in scans what commands print in English. It reads LANG itself, which stays.
        setenv("LC_ALL", "C", 1);
        plugin_ = std::make_unique<Plugin>(pluginFile_);
    }
    return *plugin_;
}

std::vector<IC::MutableNode*> Session::nodes()
{
    if (!library().started())
        plugin_->start();
    return nodesOf(plugin_->interface());
}

} // namespace mihost
