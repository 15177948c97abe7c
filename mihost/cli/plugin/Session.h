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

/** One run of the program: the options, the output, and the plug-in once a command needs it. */
class Session
{
public:
    /**
     * Opens the trace and, if requested, enters a sandbox.
     *
     * @throws Failure if one of them fails
     */
    explicit Session(Options const& options);
    Session(Session const&) = delete;
    Session& operator=(Session const&) = delete;

    /** Unloads the plug-in. @throws Failure if the trace or the output is incomplete */
    void finish();

    Options const& options() const
    {
        return options_;
    }

    /** For one line of the shell. Does not change how the plug-in was loaded. */
    void setOptions(Options const& options)
    {
        options_ = options;
        out_.setOptions(options);
        setMessageStyle(options.colours, options.quiet);
    }

    /** Sets the exit code although nothing failed. The first one that was set counts. */
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

    /** @throws Failure without a terminal and without input */
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
     * Returns only if the user agreed.
     *
     * @param command  as typed, such as "user delete"
     * @param what     such as "delete the account jdoe"
     * @throws Failure (BadUsage) if not, or without a terminal
     */
    void confirm(std::string const& command, std::string const& what) const;

    /** Prints one warning if unknown values were shown since the last call. */
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
    SinkGroup sinks_; // the last member, so that no message arrives while the others are destroyed
};

} // namespace mihost

#endif
