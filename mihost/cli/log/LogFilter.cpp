#include "mihost/cli/log/LogFilter.h"

#include "mihost/cli/system/Failure.h"

#include <array>
#include <fmt/format.h>

namespace mihost
{

void LogFilter::setPattern(std::string const& pattern)
{
    auto compiled = std::make_unique<regex_t>();
    int const problem = regcomp(compiled.get(), pattern.c_str(), REG_EXTENDED | REG_NOSUB);
    if (problem == 0) {
        pattern_.reset(compiled.release());
        return;
    }
    std::array<char, 256> reason{};
    regerror(problem, compiled.get(), reason.data(), reason.size());
    throw Failure(BadUsage, fmt::format("--grep: '{}': {}", pattern, reason.data()));
}

bool LogFilter::shows(LogLine const& line) const
{
    if (since_ && (!line.time || *line.time < *since_))
        return false;
    if (until_ && (!line.time || *line.time > *until_))
        return false;
    return !pattern_ || regexec(pattern_.get(), line.message.c_str(), 0, nullptr, 0) == 0;
}

} // namespace mihost
