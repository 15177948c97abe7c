#ifndef TESTS_SUPPORT_TIMEZONE_H
#define TESTS_SUPPORT_TIMEZONE_H

#include <cstdlib>
#include <ctime>

/** Makes local time that of the zone from now on, best given by its rules, such as "UTC0". */
inline void useZone(char const* zone)
{
    setenv("TZ", zone, 1);
    tzset();
}

#endif
