#include "util/log.h"

#include "host/VXLogger.h"

#include <new>

namespace NQ::log
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

void write(Unit const& unit, Level level, char const* text, char const* function, int line)
{
    write(unit, level, message(text), function, line);
}

void writeLast(Unit const& unit, char const* text, char const* end, char const* function,
               int line) noexcept
{
    try {
        write(unit, progress, message(text, end), function, line);
    } catch (std::bad_alloc const&) {
        return;
    }
}

Scope::Scope(Unit const& unit, Named named, char const* function, int line)
    : unit_(unit), name_(named.name ? named.name : function), function_(function), line_(line)
{
    write(unit_, progress, message(name_, ": entry"), function_, line_);
}

Scope::~Scope()
{
    writeLast(unit_, name_, ": exit", function_, line_);
}

} // namespace NQ::log
