#ifndef TESTS_SUPPORT_ERRORCOUNT_H
#define TESTS_SUPPORT_ERRORCOUNT_H

#include "host/VXLogger.h"
#include "mihost/runtime/Runtime.h"

#include <atomic>

/** Counts the errors that are logged and does nothing else, so that it costs little time. */
class ErrorCount : public mihost::LogSink
{
public:
    ErrorCount()
    {
        mihost::setLogSink(this);
    }
    ~ErrorCount() override
    {
        mihost::setLogSink(nullptr);
    }

    void write(mihost::LogMessage const& message) override
    {
        if (message.level >= VXLog::level::error)
            ++errors;
    }

    std::atomic<unsigned int> errors{0};
};

#endif
