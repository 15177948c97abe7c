#ifndef MIHOST_CLI_PLUGIN_TRACE_H
#define MIHOST_CLI_PLUGIN_TRACE_H

#include "mihost/runtime/Sinks.h"

#include <cstdio>
#include <string>

namespace mihost
{

/** The --trace file. Records added and deleted nodes while it exists. */
class Trace
{
public:
    /**
     * @param file  a path, or "-" for standard error
     * @throws Failure if the file cannot be opened for writing
     */
    explicit Trace(std::string const& file);
    ~Trace();
    Trace(Trace const&) = delete;
    Trace& operator=(Trace const&) = delete;

    /** @return the sink for the log messages */
    LogSink& sink()
    {
        return lines_;
    }

    /** @throws Failure if something could not be written */
    void finish();

private:
    std::string file_;
    std::FILE* stream_;
    LineWriter writer_;
    JsonLines lines_;
};

} // namespace mihost

#endif
