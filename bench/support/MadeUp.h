#ifndef BENCH_SUPPORT_MADEUP_H
#define BENCH_SUPPORT_MADEUP_H

#include <string>

/** What a made-up machine holds, laid over the copy that this process runs in. */
namespace madeUp
{

/**
 * Users from 10000 on, each with its own group, and one group with all of them; otherwise only
 * root.
 */
void accounts(int users);

/** So many loaded kernel modules, which the real lsmod and modinfo know. To be called once. */
void modules(int count);

/** A system log of so many lines. */
void systemLog(int lines);

} // namespace madeUp

#endif
