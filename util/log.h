#ifndef UTIL_LOG_H
#define UTIL_LOG_H

#include "host/VXMessageBuffer.h"
#include "util/internal.h"

#include <ostream>
#include <string>

/** The plug-in's log points. Not part of its interface, so nothing here is exported. */
namespace NQ
{

namespace MI_INTERNAL log
{

enum Level { progress = 3000, power = 4000, error = 6000 };

/** Where a source unit's messages come from: its logger category and its name. */
struct Unit {
    std::string const& category;
    char const* file;
};

/**
 * Hands one message to the host, once through each of the logger's two operations.
 *
 * The function name and line are those of the caller.
 */
void write(Unit const& unit, Level level, std::string const& message,
           char const* function = __builtin_FUNCTION(), int line = __builtin_LINE());

/** As above, for a fixed text. It takes a buffer of its own like every message. */
void write(Unit const& unit, Level level, char const* text,
           char const* function = __builtin_FUNCTION(), int line = __builtin_LINE());

/**
 * For destructors: as write, but a message for which there is no memory is lost.
 *
 * @param text  what the message begins with, such as "getOSName"
 * @param end   what it ends with, such as ": exit"
 */
void writeLast(Unit const& unit, char const* text, char const* end,
               char const* function = __builtin_FUNCTION(), int line = __builtin_LINE()) noexcept;

/** Assembles a message from texts and numbers in a buffer of its own. */
template <class... Parts> std::string message(Parts const&... parts)
{
    VXLog::VXMessageBuffer buffer;
    return buffer.str((buffer << ... << parts));
}

/** Logs a function's entry now and its exit on whatever path the function is left. */
class Scope
{
public:
    /** What the two messages begin with; must outlive the scope. Null: the function's own name. */
    struct Named {
        char const* name;
    };

    explicit Scope(Unit const& unit, Named named = {nullptr},
                   char const* function = __builtin_FUNCTION(), int line = __builtin_LINE());
    ~Scope();

    Scope(Scope const&) = delete;
    Scope& operator=(Scope const&) = delete;

private:
    Unit const& unit_;
    char const* name_;
    char const* function_;
    int line_;
};

} // namespace log

} // namespace NQ

#endif
