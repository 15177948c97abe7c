#include "host/VXLogger.h"

#include "mihost/runtime/Runtime.h"

#include <atomic>

namespace
{
std::atomic<mihost::LogSink*> sinkInUse{nullptr};
}

namespace mihost
{

void setLogSink(LogSink* sink)
{
    sinkInUse.store(sink, std::memory_order_release);
}

} // namespace mihost

namespace VXLog
{

void VXLogger::logLevelMessage(char const* function, char const* file, int line,
                               std::string const& category, int level, char* extra, int first,
                               int second, std::string const& message)
{
    if (mihost::LogSink* sink = sinkInUse.load(std::memory_order_acquire))
        sink->write({mihost::LogMessage::Operation::Log, function, file, line, category, level,
                     extra, first, second, message});
}

void VXLogger::traceLevelMessage(char const* function, char const* file, int line,
                                 std::string const& category, int level, char* extra, int first,
                                 int second, std::string const& message)
{
    if (mihost::LogSink* sink = sinkInUse.load(std::memory_order_acquire))
        sink->write({mihost::LogMessage::Operation::Trace, function, file, line, category, level,
                     extra, first, second, message});
}

} // namespace VXLog
