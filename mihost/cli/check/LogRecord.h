#ifndef MIHOST_CLI_CHECK_LOGRECORD_H
#define MIHOST_CLI_CHECK_LOGRECORD_H

#include "mihost/runtime/Runtime.h"

#include <mutex>
#include <string>
#include <vector>

namespace mihost::checks
{

/** One call of the logger. */
struct LoggedCall {
    LogMessage::Operation operation;
    std::string function; // empty for a null pointer
    std::string file;     // empty for a null pointer
    int line;
    std::string category;
    int level;
    bool hasExtra; // something other than the null pointer
    int first;
    int second;
    std::string text;
};

/** Records every call of the logger while it exists. */
class LogRecord : public LogSink
{
public:
    LogRecord();
    ~LogRecord() override;
    LogRecord(LogRecord const&) = delete;
    LogRecord& operator=(LogRecord const&) = delete;

    void write(LogMessage const& message) override;

    std::vector<LoggedCall> calls() const;

    void forget();

private:
    mutable std::mutex lock_;
    std::vector<LoggedCall> calls_;
};

} // namespace mihost::checks

#endif
