#ifndef MIHOST_SANDBOX_SANDBOX_H
#define MIHOST_SANDBOX_SANDBOX_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/**
 * Continues in a copy-on-write copy of this machine: commands really run there, and nothing on the
 * machine changes.
 *
 * The caller's process forks. The child returns from here inside the copy, below the copy's first
 * process. The caller's process stays outside, passes signals on, and ends like the child, by its
 * exit code or its signal, without exit handlers; by then nothing is left of the copy. If it is
 * killed, everything in the copy dies with it.
 *
 * The copy has its own mounts, processes, IPC objects, host name and network; a fresh /proc, an
 * empty /run, a /dev with only harmless devices and a read-only /sys. Powering off, loading
 * modules, setting the clock, accessing hardware, the kernel's log and audit records are not
 * permitted, and the power commands are replaced by one that only prints what it would do. This
 * protects against the ordinary effects of commands; it is not a security boundary against hostile
 * commands.
 *
 * Call it before any thread is started. Needs root's CAP_SYS_ADMIN. An unprivileged user namespace
 * is not enough: it must not overlay / and has no accounts to change.
 *
 * @param overlay  a directory whose files replace those of the copy; empty for none
 * @return nothing inside the copy; without a copy the reason, in the caller's process
 */
std::optional<std::string> enterSandbox(std::string const& overlay = "");

/** Whether this process runs in a copy that enterSandbox made. */
bool inSandbox();

/**
 * The power commands run in this copy so far, in order, such as
 * "/sbin/shutdown -h now".
 */
std::vector<std::string> refusedPowerCommands();

/**
 * Replaces files of the copy that this process runs in by a directory's files, symbolic links and
 * directories. All are owned by root and keep their modes, except that a world-readable /etc/shadow
 * or /etc/gshadow becomes readable only by root. An existing directory is kept.
 *
 * @throws std::logic_error outside a copy, std::system_error for a file that cannot be read or
 *        written
 */
void layOver(std::string const& folder);

} // namespace mihost

#endif
