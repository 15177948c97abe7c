#ifndef MIHOST_ACCEL_ACCEL_H
#define MIHOST_ACCEL_ACCEL_H

#include <stddef.h>

/**
 * The accelerator, libmiaccel.so: a popen that answers the plug-in's read-only commands inside the
 * process, with the bytes that they would print, and passes everything else to the real popen.
 *
 *   wc -l FILE      sed -n 'Np' FILE      date      lsmod      modinfo NAME
 *
 * How a host uses it. The plug-in calls popen and pclose by their ordinary names, so the first
 * definition in the process is called. Either
 *
 *  - link the program with -lmiaccel, which then comes before libc. A program that does not use
 * this header may need -Wl,--no-as-needed to keep the library. This is the preferred way. Or
 *  - start the program with LD_PRELOAD set to the full path of this library only. The commands
 *    that still run inherit it harmlessly.
 *
 * Loading it with dlopen has no effect by itself, since libc comes first. A host that defines popen
 * and pclose can call those of the loaded library, as mihost does.
 *
 * When it answers. Only if all the usual tools would print the same: PATH
 * finds the tool in a system directory; only root can replace it and the shell, and neither is a
 * script; lsmod and modinfo are links to kmod; nothing in the environment affects shell or tool;
 * the command would write nothing to standard error. date runs once an hour for comparison. A log
 * must be a regular file of a local file system. It does not answer sed if tools differ: for NUL
 * bytes and for a last line without a newline. In all other cases the real popen is called.
 *
 * The positions of a log's lines are indexed once, in 8 bytes for 64 KiB, and extended as it grows.
 * Another device, inode or change time, a shorter file, or other bytes in the first or last 16 KiB
 * of the indexed part cause a new index. Not noticed: a change further inside that keeps size and
 * times, as writes through mmap may, or that comes together with growth; other programs that root
 * installed in place of the tools, if they print something else; zone and locale files replaced
 * while in use, for up to an hour.
 *
 * The returned streams read like a pipe but have no descriptor: fileno returns -1. Close them
 * with pclose, which returns 0, the command's exit status. They contain the output as of popen and
 * hold no lock. All functions may be called from any thread.
 */

#ifdef __cplusplus
extern "C" {
#endif

#define MIACCEL_EXPORT __attribute__((visibility("default")))

/** How often a command was started since the process began. */
struct miaccel_count {
    const char* command;    /**< "wc", "sed", "date", "lsmod", "modinfo", "other" */
    unsigned long answered; /**< answered in the process */
    unsigned long ran;      /**< run by the real popen */
    const char* reason;     /**< why it last ran; null if it never did */
};

/**
 * Turns answering on or off; it is on from the start. If off, every command goes to the real popen
 * and none is counted. Open streams stay valid.
 *
 * @return 1 if it was on before, else 0
 */
MIACCEL_EXPORT int miaccel_enable(int on);

/**
 * Writes the counts, a row for each command, "other" last.
 *
 * @param counts  room for that many rows; their texts live as long as the process
 * @return the number of existing rows, which may exceed the room
 */
MIACCEL_EXPORT size_t miaccel_counts(struct miaccel_count* counts, size_t room);

#ifdef __cplusplus
}
#endif

#endif
