#ifndef MIHOST_CLI_CHECK_SUBJECT_H
#define MIHOST_CLI_CHECK_SUBJECT_H

#include "mihost/cli/check/HostEvents.h"
#include "mihost/cli/check/LogRecord.h"
#include "mihost/cli/check/TreeRules.h"
#include "mihost/cli/plugin/Plugin.h"

#include <memory>
#include <string>

namespace mihost::checks
{

/** The plug-in under check, with the host around it. One for each process. */
class Subject
{
public:
    // Not 1, so that a plug-in with a built-in id is found.
    static constexpr unsigned int ownId = 7001;

    Subject(std::string file, unsigned int rounds);

    std::string const& file() const
    {
        return file_;
    }

    /** How often a repeated check repeats. */
    unsigned int rounds() const
    {
        return rounds_;
    }

    /** The library, loaded at the first call. @throws Failure if it cannot be */
    Plugin& plugin();

    IC::ManagementInterface& interface()
    {
        return plugin().interface();
    }

    /** Lets the plug-in build its tree. */
    IC::Error initialize();

    void unload();

    /** Closes the library; the next use of the plug-in loads it again. */
    void close();

    Nodes nodes();

    /** The operating-system node. @throws std::runtime_error if there is none */
    IC::MutableNode& os();

    HostEvents& events()
    {
        return events_;
    }

    std::vector<LoggedCall> log() const
    {
        return log_.calls();
    }

    void forgetLog()
    {
        log_.forget();
    }

private:
    std::string file_;
    unsigned int rounds_;
    LogRecord log_;
    HostEvents events_;
    std::unique_ptr<Plugin> plugin_;
};

} // namespace mihost::checks

#endif
