#ifndef MIHOST_CLI_LOG_LOGFILTER_H
#define MIHOST_CLI_LOG_LOGFILTER_H

#include "mihost/cli/log/LogLine.h"

#include <memory>
#include <optional>
#include <regex.h>
#include <string>

namespace mihost
{

/** Which log entries are shown. */
class LogFilter
{
public:
    /** Entries without a time are not shown if one of the two is given. */
    void setSince(long since)
    {
        since_ = since;
    }
    void setUntil(long until)
    {
        until_ = until;
    }

    /** @param pattern  an extended regular expression. @throws Failure (BadUsage) for a wrong one
     */
    void setPattern(std::string const& pattern);

    bool shows(LogLine const& line) const;

private:
    struct FreePattern {
        void operator()(regex_t* pattern) const
        {
            regfree(pattern);
            delete pattern;
        }
    };

    std::optional<long> since_;
    std::optional<long> until_;
    std::unique_ptr<regex_t, FreePattern> pattern_;
};

} // namespace mihost

#endif
