#include "mihost/sandbox/Sandbox.h"

#include "mihost/sandbox/Content.h"
#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/LayOver.h"
#include "mihost/sandbox/MachineCopy.h"
#include "mihost/sandbox/Network.h"
#include "mihost/sandbox/Pipe.h"
#include "mihost/sandbox/Power.h"
#include "mihost/sandbox/Privileges.h"
#include "mihost/sandbox/Relay.h"
#include "mihost/sandbox/Self.h"
#include "mihost/sandbox/SystemCall.h"

#include <cstdio>
#include <poll.h>
#include <sched.h>
#include <sys/prctl.h>
#include <sys/wait.h>

namespace mihost
{

namespace
{

// What the copy's first process reports to the caller's: once that all is ready or what failed,
// and in the end the wait status.
constexpr char ready = 'r';
constexpr char problem = 'p';

bool inside = false;

std::string readToEnd(Descriptor const& from)
{
    std::string text;
    char block[512];
    for (;;) {
        ssize_t const count = read(from.get(), block, sizeof block);
        if (count < 0 && errno == EINTR)
            continue;
        if (count <= 0)
            return text;
        text.append(block, static_cast<std::size_t>(count));
    }
}

/** The child is the first process of a process namespace; later children are not in it. */
pid_t forkFirstProcess()
{
    Descriptor const own = openSelf();
    check(unshare(CLONE_NEWPID), "cannot create a process namespace");
    pid_t const child = fork();
    int const problemOfFork = errno;
    if (child != 0)
        check(setns(own.get(), CLONE_NEWPID), "cannot return to the process namespace");
    errno = problemOfFork;
    return check(child, "cannot start a process");
}

/** Dies with the caller's process, which holds the pipe's other end. */
void dieWithTheCaller(Descriptor const& report)
{
    prctl(PR_SET_PDEATHSIG, SIGKILL);
    pollfd watched{report.get(), 0, 0};
    if (poll(&watched, 1, 0) != 0)
        _exit(EXIT_FAILURE); // it ended before
}

void makeSandbox(Descriptor const& overlay)
{
    check(unshare(CLONE_NEWNS | CLONE_NEWIPC | CLONE_NEWUTS | CLONE_NEWNET),
          "cannot create namespaces");
    startLoopback();
    enterMachineCopy();
    if (overlay)
        layOver(overlay);
    replacePowerCommands();
    refuseKernelsRecords();
    dropMachinePrivileges();
}

/** Returns only in the sandboxed process; the copy's first process stays here and waits for it. */
void runAsFirstProcess(Descriptor overlay, Descriptor report)
{
    pid_t child = -1;
    try {
        dieWithTheCaller(report);
        makeSandbox(overlay);
        overlay.reset();
        child = check(fork(), "cannot start a process");
    } catch (std::exception const& error) {
        std::string const text = problem + std::string(error.what());
        if (write(report.get(), text.data(), text.size()) < 0)
            _exit(EXIT_FAILURE);
        _exit(EXIT_SUCCESS);
    }
    if (child == 0)
        return;
    try {
        writeAll(report, &ready, 1, "the report");
        int const status = relayTo(child);
        writeAll(report, reinterpret_cast<char const*>(&status), sizeof status, "the report");
    } catch (std::system_error const&) {
        _exit(EXIT_FAILURE); // the caller's process has ended
    }
    _exit(EXIT_SUCCESS);
}

/** Returns only if no sandbox was created. */
std::string runAsCaller(pid_t child, Descriptor report)
{
    char first = 0;
    ssize_t count = 0;
    do {
        count = read(report.get(), &first, 1);
    } while (count < 0 && errno == EINTR);
    if (count == 1 && first == ready) {
        int end = relayTo(child); // the first process's wait status; used if it was killed
        std::string const status = readToEnd(report);
        if (status.size() == sizeof end)
            status.copy(reinterpret_cast<char*>(&end), sizeof end);
        endLike(end);
    }
    std::string const reason = readToEnd(report);
    waitpid(child, nullptr, 0);
    return reason.empty() ? "the copy's first process ended early" : reason;
}

} // namespace

std::optional<std::string> enterSandbox(std::string const& overlay)
{
    try {
        Descriptor folder = overlay.empty() ? Descriptor() : openFolder(overlay);
        Pipe report;
        HeldSignals const held;
        signal(SIGCHLD, SIG_DFL); // if ignored, children's ends would not be noticed
        std::fflush(nullptr);     // or both processes would write the buffered output
        pid_t const child = forkFirstProcess();
        if (child == 0) {
            report.readEnd.reset();
            runAsFirstProcess(std::move(folder), std::move(report.writeEnd));
            inside = true;
            return std::nullopt;
        }
        report.writeEnd.reset();
        return runAsCaller(child, std::move(report.readEnd));
    } catch (std::system_error const& error) {
        if (error.code() == std::errc::operation_not_permitted && geteuid() != 0)
            return std::string(error.what()) + " (root's privileges are needed)";
        return error.what();
    }
}

bool inSandbox()
{
    return inside;
}

} // namespace mihost
