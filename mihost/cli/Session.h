#ifndef MIHOST_CLI_SESSION_H
#define MIHOST_CLI_SESSION_H

#include "mihost/cli/Address.h"
#include "mihost/cli/NodeView.h"
#include "mihost/cli/Options.h"
#include "mihost/cli/Output.h"
#include "mihost/cli/Plugin.h"
#include "mihost/cli/PrivateDirectory.h"
#include "mihost/cli/Trace.h"

#include <memory>

namespace mihost
{

/** One run of the program: the options, the output, and the plug-in once a command wants it. */
class Session
{
public:
    /**
     * Opens the trace and, where that is asked for, goes on in a sandbox.
     *
     * @throws Failure where one of them cannot be had
     */
    explicit Session(Options options);

    /** Takes the plug-in down. @throws Failure where the trace or the output was cut short */
    void finish();

    Options const& options() const
    {
        return options_;
    }
    Output& out()
    {
        return out_;
    }
    Secrets secrets() const
    {
        return options_.showSecrets ? Secrets::Show : Secrets::Hide;
    }

    /** The plug-in, loaded but perhaps not started. */
    Plugin& library();

    /** The nodes of the started plug-in, in the order of the host's list. */
    std::vector<IC::MutableNode*> nodes();

private:
    Options options_;
    Output out_;
    std::string pluginFile_;
    std::unique_ptr<Trace> trace_;
    std::unique_ptr<PrivateDirectory> directory_;
    std::unique_ptr<Plugin> plugin_;
};

} // namespace mihost

#endif
