#include "mihost/cli/Session.h"

#include <cstdlib>
#include <utility>

namespace mihost
{

Session::Session(Options options)
    : options_(std::move(options)), out_(stdout), pluginFile_(pluginFile(options_.plugin))
{
    if (!options_.trace.empty())
        trace_ = std::make_unique<Trace>(options_.trace);
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
