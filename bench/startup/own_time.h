#ifndef BENCH_STARTUP_OWN_TIME_H
#define BENCH_STARTUP_OWN_TIME_H

#include <stdio.h>
#include <sys/resource.h>

/* Prints the processor time of this process without its children, in microseconds. */
static inline void printOwnTime(void)
{
    struct rusage own;
    getrusage(RUSAGE_SELF, &own);
    printf("%lld\n", 1000000LL * (own.ru_utime.tv_sec + own.ru_stime.tv_sec) +
                         own.ru_utime.tv_usec + own.ru_stime.tv_usec);
}

#endif
