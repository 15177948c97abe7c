#ifndef MIHOST_RUNTIME_RUNTIME_H
#define MIHOST_RUNTIME_RUNTIME_H

#include <string>

namespace IC
{
class Error;
class Node;
} // namespace IC

namespace mihost
{

/** One message as passed to the logger. Valid only during LogSink::write. */
struct LogMessage {
    enum class Operation { Log, Trace };

    Operation operation;
    char const* function;
    char const* file;
    int line;
    std::string const& category;
    int level;
    char const* extra;
    int first;
    int second;
    std::string const& text;
};

/** Receives every logger call. write() may be called from several threads at once. */
class LogSink
{
public:
    virtual ~LogSink();
    virtual void write(LogMessage const& message) = 0;
};

/** Informed of nodes added and deleted after the start; the node exists during the call. */
class NodeObserver
{
public:
    virtual ~NodeObserver();
    virtual void nodeAdded(IC::Node const& node) = 0;
    virtual void nodeDeleted(IC::Node const& node) = 0;
};

/**
 * Sets the sink of log messages, null for none. The caller owns the sink, which must outlive its
 * use. Set it while no plug-in code runs.
 */
void setLogSink(LogSink* sink);

/** Sets the observer of nodes, null for none. Ownership and timing as for the sink. */
void setNodeObserver(NodeObserver* observer);

NodeObserver* nodeObserver();

/**
 * Sets what the framework's initialize returns from now on, null for success. The interface is
 * prepared in any case, which shows whether a plug-in builds its tree after a failure. The caller
 * owns the answer, which must outlive its use.
 */
void setInitializeAnswer(IC::Error const* answer);

IC::Error const* initializeAnswer();

} // namespace mihost

#endif
