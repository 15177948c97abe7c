#include "util/log.h"

#include <new>

namespace NQ::log
{

namespace
{

/** Passes one message to the host, once through each of the logger's two operations. */
void hand(Unit const& unit, int level, std::string const& message, char const* function, int line)
{
    using VXLog::VXLogger;
    VXLogger::logLevelMessage(function, unit.file, line, unit.category, level, nullptr, 0, 0,
                              message);
    VXLogger::traceLevelMessage(function, unit.file, line, unit.category, level, nullptr, 0, 0,
                                message);
}

void handLast(Unit const& unit, char const* name, char const* end, char const* function,
              int line) noexcept
{
    try {
        hand(unit, VXLog::level::progress, assembled(name, end), function, line);
    } catch (std::bad_alloc const&) {
        return;
    }
}

} // namespace

Scope::Scope(Unit const& unit, Named named, char const* function, int line)
    : unit_(unit), name_(named.name ? named.name : function), function_(function), line_(line)
{
    entry(unit_, name_, function_, line_);
}

Scope::~Scope()
{
    handLast(unit_, name_, ": exit", function_, line_);
}

void Scope::write(int level, std::string const& message, int line) const
{
    hand(unit_, level, message, function_, line);
}

void entry(Unit const& unit, char const* name, char const* function, int line)
{
    hand(unit, VXLog::level::progress, assembled(name, ": entry"), function, line);
}

void lastEntry(Unit const& unit, char const* name, char const* function, int line) noexcept
{
    handLast(unit, name, ": entry", function, line);
}

} // namespace NQ::log
