#include "util/log.h"

#include "host/VXLogger.h"

namespace NQ::LOG
{

void write(Unit const& unit, Level level, std::string const& message, char const* function,
           int line)
{
    using VXLog::VXLogger;
    VXLogger::logLevelMessage(function, unit.file, line, unit.category, level, nullptr, 0, 0,
                              message);
    VXLogger::traceLevelMessage(function, unit.file, line, unit.category, level, nullptr, 0, 0,
                                message);
}

Scope::Scope(Unit const& unit, Named named, char const* function, int line)
    : unit_(unit), name_(named.name ? named.name : function), function_(function), line_(line)
{
    write(unit_, progress, message(name_, ": entry"), function_, line_);
}

Scope::~Scope()
{
    write(unit_, progress, message(name_, ": exit"), function_, line_);
}

} // namespace NQ::LOG
