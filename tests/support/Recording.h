#ifndef TESTS_SUPPORT_RECORDING_H
#define TESTS_SUPPORT_RECORDING_H

#include "mihost/runtime/Runtime.h"

#include <mutex>
#include <string>
#include <vector>

/** One call of the logger. */
struct LogRecord {
    bool trace; // false for the level log, true for the trace log
    std::string function;
    std::string file;
    int line;
    std::string category;
    int level;
    bool extraIsNull;
    int first;
    int second;
    std::string text;
};

/** Records every logger call of the process while it exists. */
class Recording : public mihost::LogSink
{
public:
    Recording();
    ~Recording() override;

    void write(mihost::LogMessage const& message) override;

    std::vector<LogRecord> records() const;

    /** @return the texts of the level log, in order; if level is not 0, only those of that level */
    std::vector<std::string> texts(int level = 0) const;

    /** @return the texts other than entry and exit lines */
    std::vector<std::string> remarks() const;

    /** @return "FUNCTION FILE CATEGORY" of each kind of message, sorted, once each */
    std::vector<std::string> sources() const;

    bool has(std::string const& text, int level) const;
    void clear();

private:
    mutable std::mutex lock_;
    std::vector<LogRecord> records_;
};

#endif
