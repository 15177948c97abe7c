#ifndef UTIL_LOG_H
#define UTIL_LOG_H

#include "host/VXLogger.h"
#include "host/VXMessageBuffer.h"
#include "util/internal.h"

#include <ostream>
#include <string>

/** The plug-in's logging. Not part of its interface, so nothing here is exported. */
namespace NQ
{

namespace MI_INTERNAL log
{

/** Where a source unit's messages come from: its logger category and its name. */
struct Unit {
    std::string const& category;
    char const* file;
};

/** What a message begins with, and the source line that writes it. */
struct Beginning {
    Beginning(char const* words, int sourceLine = __builtin_LINE()) : text(words), line(sourceLine)
    {
    }

    char const* text;
    int line;
};

/** A message built from texts and numbers, in its own buffer. */
template <class... Pieces> std::string assembled(Pieces const&... pieces)
{
    VXLog::VXMessageBuffer buffer;
    return buffer.str((buffer << ... << pieces));
}

/** Logs a function's entry now and its exit on every path out of the function. */
class Scope
{
public:
    /** What the two messages begin with; must outlive the scope. Null: the function's own name. */
    struct Named {
        char const* name;
    };

    explicit Scope(Unit const& unit, Named named = {nullptr},
                   char const* function = __builtin_FUNCTION(), int line = __builtin_LINE());

    /** Without memory, the exit is not logged. */
    ~Scope();

    Scope(Scope const&) = delete;
    Scope& operator=(Scope const&) = delete;

    // Each writes one message of the function, at the level of its name.

    template <class... Rest> void progress(Beginning first, Rest const&... rest) const
    {
        write(VXLog::level::progress, assembled(first.text, rest...), first.line);
    }

    template <class... Rest> void power(Beginning first, Rest const&... rest) const
    {
        write(VXLog::level::power, assembled(first.text, rest...), first.line);
    }

    template <class... Rest> void error(Beginning first, Rest const&... rest) const
    {
        write(VXLog::level::error, assembled(first.text, rest...), first.line);
    }

private:
    void write(int level, std::string const& message, int line) const;

    Unit const& unit_;
    char const* name_;
    char const* function_;
    int line_;
};

/** Logs the entry of a constructor, for which there is no exit. */
void entry(Unit const& unit, char const* name, char const* function = __builtin_FUNCTION(),
           int line = __builtin_LINE());

/** Like entry, for a destructor; not logged without memory. */
void lastEntry(Unit const& unit, char const* name, char const* function = __builtin_FUNCTION(),
               int line = __builtin_LINE()) noexcept;

} // namespace log

} // namespace NQ

#endif
