#ifndef MIHOST_CLI_PLUGIN_PROGRESS_H
#define MIHOST_CLI_PLUGIN_PROGRESS_H

#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/plugin/Phases.h"

#include <string>

namespace mihost
{

/**
 * Shows on standard error, in one line that goes away, which phase the start-up is in and how far:
 * "drivers 57/120". To be made only where that is a terminal.
 */
class Progress : public PhaseListener, public LogSink, public commandTap::Listener
{
public:
    Progress();
    ~Progress() override;
    Progress(Progress const&) = delete;
    Progress& operator=(Progress const&) = delete;

    void phaseBegins(Phase const& phase) override;
    void phaseEnds(Phase const& phase) override;
    void write(LogMessage const& message) override;
    void commandStarts(char const* line) override;

private:
    void step();
    void show() const;

    std::string phase_;
    unsigned int done_ = 0;
    unsigned int total_ = 0; // 0 where it is not known
};

} // namespace mihost

#endif
