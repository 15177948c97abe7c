#ifndef MIHOST_CLI_PLUGIN_PHASECOUNTER_H
#define MIHOST_CLI_PLUGIN_PHASECOUNTER_H

#include "mihost/cli/plugin/Phases.h"

#include <string>

namespace mihost
{

struct PhaseSteps;

/** How far a phase of the start is, by the plug-in's own messages. */
class PhaseCounter
{
public:
    void begin(Phase const& phase);
    void end();

    /** @return whether the message changed the count */
    bool take(LogMessage const& message);

    unsigned int done() const
    {
        return done_;
    }

    /** The phase and its count, such as "groups 3/57" or "drivers 3"; empty outside of phases. */
    std::string text() const;

private:
    std::string phase_;
    PhaseSteps const* steps_ = nullptr; // null if the phase's steps are not counted
    unsigned int done_ = 0;
    unsigned int total_ = 0; // 0 until the plug-in logs it
};

} // namespace mihost

#endif
