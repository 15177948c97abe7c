#ifndef HOST_VXLOGGER_H
#define HOST_VXLOGGER_H

#include <string>

namespace VXLog
{

/**
 * The host's log. Both operations take the same arguments and may be called from any thread; a
 * management interface calls first the one and then the other for each of its messages.
 *
 * @param function  name of the function that speaks
 * @param file      its source unit, such as "OsSwMI"
 * @param line      its source line
 * @param category  the unit's dotted category
 * @param level     3000 progress, 4000 power actions, 6000 errors
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
