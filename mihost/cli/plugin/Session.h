#ifndef MIHOST_CLI_PLUGIN_SESSION_H
#define MIHOST_CLI_PLUGIN_SESSION_H

#include "mihost/cli/input/Address.h"
#include "mihost/cli/input/Options.h"
#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"
#include "mihost/cli/plugin/AcceleratorLoader.h"
#include "mihost/cli/plugin/Phases.h"
#include "mihost/cli/plugin/Plugin.h"
#include "mihost/cli/plugin/Redaction.h"
#include "mihost/cli/plugin/Timing.h"
#include "mihost/cli/plugin/Trace.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/PrivateDirectory.h"
#include "mihost/cli/system/Stderr.h"

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
    explicit Session(Options const& options);
    Session(Session const&) = delete;
    Session& operator=(Session const&) = delete;

    /** Takes the plug-in down. @throws Failure where the trace or the output was cut short */
    void finish();

    Options const& options() const
    {
        return options_;
    }

    /** For one line of the shell. How the plug-in was loaded stays as it was. */
    void setOptions(Options const& options)
    {
        options_ = options;
        out_.setOptions(options);
        setMessageStyle(options.colours, options.quiet);
    }

    /** What the program exits with although nothing failed; the first one that was set. */
    void endWith(ExitCode code);
    ExitCode exitCode() const
    {
        return exitCode_;
    }

    /** Standard input is a script from now on, so no secret can be read from it. */
    void setScripted()
    {
        scripted_ = true;
    }

    bool isScripted() const
    {
        return scripted_;
    }

    /** @throws Failure where there is nobody to ask and nothing to read */
    std::string askSecret(std::string const& name) const;
    Output& out()
    {
        return out_;
    }
    Secrets secrets() const
    {
        return options_.showSecrets ? Secrets::Show : Secrets::Hide;
    }

    /** The plug-in, loaded but perhaps not started. @throws Failure */
    Plugin& plugin();

    /** The nodes of the started plug-in, in the order of the host's list. @throws Failure */
    std::vector<IC::MutableNode*> nodes();

    /** The one node of this address. @throws Failure */
    IC::MutableNode& node(std::string const& address);

    /**
     * Returns where that is to be done.
     *
     * @param what  such as "delete the account jdoe"
     * @throws Failure (BadUsage) where it is not, or where nobody can be asked
     */
    void confirm(std::string const& what) const;

    /** Gives one warning if values were shown as unknown since it was last called. */
    static void warnOfUnknown();

private:
    void start();
    std::string timingReport() const;

    Options options_;
    ExitCode exitCode_ = Done;
    bool scripted_ = false;
    Output out_;
    std::string pluginFile_;
    Timing timing_;
    std::unique_ptr<Trace> trace_;
    std::unique_ptr<RedactingSink> traceSink_;
    std::unique_ptr<Accelerator> accelerator_;
    std::unique_ptr<PrivateDirectory> directory_;
    std::unique_ptr<Plugin> plugin_;
    SinkGroup sinks_; // the last, so that no message comes in while the others go
};

} // namespace mihost

#endif
