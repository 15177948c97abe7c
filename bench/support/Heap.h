#ifndef BENCH_SUPPORT_HEAP_H
#define BENCH_SUPPORT_HEAP_H

/**
 * Calls of malloc, calloc and realloc in this program and all that it loads, since it began.
 *
 * operator new calls malloc, so each allocation counts once.
 */
unsigned long allocations();

#endif
