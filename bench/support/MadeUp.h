#ifndef BENCH_SUPPORT_MADEUP_H
#define BENCH_SUPPORT_MADEUP_H

#include <string>

/** Adds invented contents to the copy of the machine that this process runs in. */
namespace madeUp
{

/**
 * Users from 10000 on, each with its own group, and one group with all of them; otherwise only
 * root.
 */
void accounts(int users);

/** Makes lsmod and modinfo list that many loaded kernel modules. Call it once. */
void modules(int count);

/** Writes a system log of that many lines. */
void systemLog(int lines);

} // namespace madeUp

#endif
