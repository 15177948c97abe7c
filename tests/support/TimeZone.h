#ifndef TESTS_SUPPORT_TIMEZONE_H
#define TESTS_SUPPORT_TIMEZONE_H

#include <cstdlib>
#include <ctime>

/** From now on local time is that of the zone, which is best given by its rules: "UTC0". */
inline void useZone(char const* zone)
{
    setenv("TZ", zone, 1);
    tzset();
}

#endif
