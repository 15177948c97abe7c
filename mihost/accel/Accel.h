#ifndef MIHOST_ACCEL_ACCEL_H
#define MIHOST_ACCEL_ACCEL_H

#include <stddef.h>

/**
 * The accelerator, libmiaccel.so: a popen that answers the plug-in's read-only commands in the
 * process, byte for byte as the commands would, and leaves everything else to the real popen.
 *
 *   wc -l FILE      sed -n 'Np' FILE      date      lsmod      modinfo NAME
 *
 * How a host uses it. The plug-in calls popen and pclose by their ordinary names, so whoever
 * defines them first in the process is called. Either
 *
 *  - link the program with -lmiaccel, which then comes before libc. A program that calls nothing of
 *    this header may need -Wl,--no-as-needed to keep the library. Prefer this way; or
 *  - start the program with LD_PRELOAD naming this library alone, by its full path. The commands
 *    that are still run inherit it, without harm.
 *
 * Loading it with dlopen changes nothing by itself: libc comes first then. A host with a popen and
 * pclose of its own can call those of the library so loaded, as mihost does.
 *
 * When it answers. Only if the command would print just that with any of the usual tools: PATH
 * finds the tool in a system directory; root alone can replace it and the shell, and neither is a
 * script; lsmod and modinfo are links to kmod; nothing in the environment changes what shell or
 * tool do; the command would write nothing to standard error. date is run once an hour to compare.
 * A log must be a regular file of a local file system. sed's answers end where tools differ: at
 * NUL bytes and at a last line without an end. In all other cases the real popen is called.
 *
 * The positions of a log's lines are indexed once, in 8 bytes for 64 KiB, and extended as it grows.
 * Another device, inode or change time, a shorter file, and other bytes in the first or last 16 KiB
 * of what was indexed have it read again. What remains unnoticed: a change further inside that
 * keeps the number of bytes and the times, as writes through mmap may, or that comes together with
 * growth; programs of other makes that root put in the tools' places, if they print something else;
 * zone and locale files that are replaced while they are in use, for up to an hour.
 *
 * The streams returned read as a pipe does, but have no descriptor: fileno gives -1. Close them
 * with pclose, which returns 0, the command's exit status. They hold what the command printed at
 * the time of popen, and no lock. Everything here may be called from any thread.
 */

#ifdef __cplusplus
extern "C" {
#endif

#define MIACCEL_EXPORT __attribute__((visibility("default")))

/** How often a command was asked for since the process began. */
struct miaccel_count {
    const char* command;     /**< "wc", "sed", "date", "lsmod", "modinfo", "other" */
    unsigned long answered;  /**< answered in the process */
    unsigned long handed_on; /**< run by the real popen */
    const char* reason;      /**< why it was last handed on; null if it never was */
};

/**
 * Turns answering on or off; it is on from the start. Turned off, every command goes to the real
 * popen and none is counted. Streams that are open stay good.
 *
 * @return 1 if it was on before, else 0
 */
MIACCEL_EXPORT int miaccel_enable(int on);

/**
 * Writes the counts, a row for each command, "other" last.
 *
 * @param counts  room for that many rows; the texts in them live as long as the process
 * @return the number of rows there are, which may be more than there was room for
 */
MIACCEL_EXPORT size_t miaccel_counts(struct miaccel_count* counts, size_t room);

#ifdef __cplusplus
}
#endif

#endif
