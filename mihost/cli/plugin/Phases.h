#ifndef MIHOST_CLI_PLUGIN_PHASES_H
#define MIHOST_CLI_PLUGIN_PHASES_H

#include "mihost/runtime/Runtime.h"

#include <vector>

namespace mihost
{

/** One phase of the plug-in's start. */
struct Phase {
    char const* function; // of the plug-in; it logs its entry and its exit
    char const* name;
};

std::vector<Phase> const& phases();

class PhaseListener
{
public:
    virtual ~PhaseListener() = default;
    virtual void phaseBegins(Phase const& phase) = 0;
    virtual void phaseEnds(Phase const& phase) = 0;
};

/** Derives phases from the plug-in's log messages. */
class PhaseSink : public LogSink
{
public:
    /** @param listeners  owned by the caller */
    explicit PhaseSink(std::vector<PhaseListener*> listeners);

    void write(LogMessage const& message) override;

private:
    std::vector<PhaseListener*> listeners_;
};

/** Passes messages to several sinks, owned by the caller; is the log's sink while it has any. */
class SinkGroup : public LogSink
{
public:
    SinkGroup() = default;
    ~SinkGroup() override;
    SinkGroup(SinkGroup const&) = delete;
    SinkGroup& operator=(SinkGroup const&) = delete;

    void add(LogSink& sink);
    void remove(LogSink const& sink);

    void write(LogMessage const& message) override;

private:
    std::vector<LogSink*> sinks_;
};

} // namespace mihost

#endif
