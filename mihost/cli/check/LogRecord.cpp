#include "mihost/cli/check/LogRecord.h"

namespace mihost::checks
{

namespace
{

std::string orEmpty(char const* text)
{
    return text ? text : "";
}

} // namespace

LogRecord::LogRecord()
{
    setLogSink(this);
}

LogRecord::~LogRecord()
{
    setLogSink(nullptr);
}

void LogRecord::write(LogMessage const& message)
{
    std::lock_guard const held(lock_);
    calls_.push_back({message.operation, orEmpty(message.function), orEmpty(message.file),
                      message.line, message.category, message.level, message.extra != nullptr,
                      message.first, message.second, message.text});
}

std::vector<LoggedCall> LogRecord::calls() const
{
    std::lock_guard const held(lock_);
    return calls_;
}

void LogRecord::forget()
{
    std::lock_guard const held(lock_);
    std::vector<LoggedCall>().swap(calls_);
}

} // namespace mihost::checks
