#ifndef HOST_VXLOGGER_H
#define HOST_VXLOGGER_H

#include <string>

namespace VXLog
{

/** The levels of messages. */
namespace level
{

constexpr int progress = 3000; // entries and exits of functions, and progress
constexpr int power = 4000;    // the machine is about to halt or to restart
constexpr int error = 6000;

} // namespace level

/**
 * The host's log. Both operations take the same arguments and may be called from any thread; a
 * management interface calls the first and then the second for each message.
 *
 * @param function  name of the function that logs
 * @param file      its source unit, such as "OsSwMI"
 * @param line      its source line
 * @param category  the unit's dotted category
 * @param level     one of those above
 * @param extra     null
 * @param first     0
 * @param second    0
 * @param message   the text
 */
class VXLogger
{
public:
    static void logLevelMessage(char const* function, char const* file, int line,
                                std::string const& category, int level, char* extra, int first,
                                int second, std::string const& message);
    static void traceLevelMessage(char const* function, char const* file, int line,
                                  std::string const& category, int level, char* extra, int first,
                                  int second, std::string const& message);
};

} // namespace VXLog

#endif
