#ifndef MIHOST_SANDBOX_SANDBOX_H
#define MIHOST_SANDBOX_SANDBOX_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/**
 * Goes on in a copy-on-write copy of this machine: every command really runs there, nothing on the
 * machine changes.
 *
 * The caller's process forks. Its child returns from here inside the copy, as one that the copy's
 * own first process looks after. The caller's process stays behind, passes signals on, and ends as
 * the child ends, by its exit code or its signal, without any exit handlers; by then nothing is
 * left of the copy. Should it be killed, everything in the copy dies with it.
 *
 * The copy has its own mounts, processes, IPC objects, host name and network; a fresh /proc, an
 * empty /run, a /dev with the harmless devices only and a read-only /sys. Powering off, loading
 * modules, setting the clock, reaching hardware and the kernel's log and audit records are not
 * permitted there, and the power commands are replaced by one that only says what it would do. This
 * guards against what commands do by their nature; it is not a security boundary against hostile
 * commands.
 *
 * Call it before any thread is started. Needs CAP_SYS_ADMIN, as root has it. An unprivileged user
 * namespace is no way round: it may not overlay / and knows no accounts to change.
 *
 * @param overlay  a folder whose files are laid over the copy first; empty for none
 * @return nothing inside the copy; where no copy can be had, the reason, in the caller's process
 */
std::optional<std::string> enterSandbox(std::string const& overlay = "");

/** Whether this process runs in a copy that enterSandbox made. */
bool inSandbox();

/**
 * The power commands that were asked for in this copy so far, in order, such as
 * "/sbin/shutdown -h now".
 */
std::vector<std::string> refusedPowerCommands();

/**
 * Lays a folder's files over the copy that this process runs in: files, symbolic links and
 * folders. All are owned by root and keep their modes, save that /etc/shadow and /etc/gshadow are
 * root's alone where everybody could have read them. A folder that exists already stays as it is.
 *
 * @throws std::logic_error outside a copy, std::system_error for a file that cannot be read or
 *        written
 */
void layOver(std::string const& folder);

} // namespace mihost

#endif
