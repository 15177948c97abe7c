#ifndef MIHOST_CLI_PLUGIN_PROGRESS_H
#define MIHOST_CLI_PLUGIN_PROGRESS_H

#include "mihost/cli/plugin/PhaseCounter.h"

namespace mihost
{

/**
 * Shows on standard error, in one temporary line, the phase of the start-up and its progress:
 * "groups 57/120". Create it only if that is a terminal.
 */
class Progress : public PhaseListener, public LogSink
{
public:
    Progress();
    ~Progress() override;
    Progress(Progress const&) = delete;
    Progress& operator=(Progress const&) = delete;

    void phaseBegins(Phase const& phase) override;
    void phaseEnds(Phase const& phase) override;
    void write(LogMessage const& message) override;

private:
    void show() const;

    PhaseCounter counter_;
};

} // namespace mihost

#endif
