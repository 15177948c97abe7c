#ifndef MIHOST_CLI_PLUGIN_TIMING_H
#define MIHOST_CLI_PLUGIN_TIMING_H

#include "mihost/cli/output/Json.h"
#include "mihost/cli/plugin/Phases.h"

#include <chrono>
#include <string>
#include <vector>

namespace mihost
{

/** How long each phase of the start-up took, and how many commands it ran. */
class Timing : public PhaseListener
{
public:
    using Clock = std::chrono::steady_clock;

    struct Row {
        std::string phase;
        Clock::duration time;
        unsigned int commands;
    };

    void begin(std::string const& phase);
    void end();

    void phaseBegins(Phase const& phase) override;
    void phaseEnds(Phase const& phase) override;

    std::vector<Row> const& rows() const
    {
        return rows_;
    }

private:
    Clock::time_point began_;
    unsigned int commandsBefore_ = 0;
    std::vector<Row> rows_;
};

/** The rows and their sum, for people to read. */
std::string timingText(std::vector<Timing::Row> const& rows);

Json toJson(std::vector<Timing::Row> const& rows);

} // namespace mihost

#endif
