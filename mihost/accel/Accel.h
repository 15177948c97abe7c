#ifndef MIHOST_ACCEL_ACCEL_H
#define MIHOST_ACCEL_ACCEL_H

#include <stddef.h>

/**
 * The accelerator, libmiaccel.so: a popen that answers the plug-in's read-only commands in the
 * process, byte for byte as the commands would, and hands everything else to the real popen.
 *
 *   wc -l FILE      sed -n 'Np' FILE      date      lsmod      modinfo NAME
 *
 * How a host brings it. The plug-in calls popen and pclose by their ordinary names, so whoever
 * defines them first in the process's scope is asked. Either
 *
 *  - link the program with -lmiaccel, which then stands before libc. A program that calls
 *    nothing of this header may need -Wl,--no-as-needed to keep the library. miaccel_enable turns
 *    it off and on at run time. This is the way to prefer: nothing is left in the environment for
 *    the commands that still run; or
 *  - start the program with LD_PRELOAD naming this library and nothing else. The commands that
 *    still run inherit it, without harm.
 *
 * Loading it with dlopen changes nothing by itself: libc comes first then. A host with a popen and
 * pclose of its own can call those of the library so loaded, as mihost does for --fast, and is
 * spared what the library needs while it is not asked for. Load it early: what the process may have
 * read before (time zones, locales) is taken to be as it was at that time.
 *
 * When it answers. Only where it is sure what the command would print: the shell and the tool that
 * the shell would find through PATH hold what their Debian package installed, in a version whose
 * output is known; nothing in the environment could make them behave otherwise; what they read is
 * there and readable; and they would write nothing to standard error. In all other cases the real
 * popen is asked, and the command does whatever it does.
 *
 * Files are read through an index of their line positions, kept from one command to the next. It
 * holds a bounded part of the file's size (at most 128 KiB for each file, 16 files) and is made
 * anew when device, inode, size or change time tell that the file is another one. A file above 1
 * MiB that has only become longer, and whose ends read as before, is taken for a log that was
 * appended to. Files that are no regular ones, or whose file system is not known to keep change
 * times well, are left to the real commands.
 *
 * The streams returned read as a pipe does, save that fileno knows no descriptor for them (it gives
 * -1, EBADF). They are closed with pclose, which answers 0, the command's exit status; fclose does
 * as well. They hold what the command printed at the time of popen, and no lock.
 *
 * Everything here may be called from any thread.
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
    const char* reason;      /**< why it was last handed on; null where it never was */
};

/**
 * Turns answering on or off; it is on from the start. Turned off, every command goes to the real
 * popen and none is counted. Streams that are open stay good.
 *
 * @return 1 where it was on before, else 0
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
