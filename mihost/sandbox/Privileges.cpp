#include "mihost/sandbox/Privileges.h"

#include "mihost/sandbox/SystemCall.h"

#include <cstdint>
#include <linux/netlink.h>
#include <memory>
#include <seccomp.h>
#include <sys/capability.h>
#include <sys/socket.h>
#include <type_traits>

namespace mihost
{

namespace
{

constexpr cap_value_t machinePrivileges[] = {
    CAP_AUDIT_CONTROL,  // turn auditing off and on
    CAP_AUDIT_READ,     // listen to audit records
    CAP_AUDIT_WRITE,    // add audit records
    CAP_BLOCK_SUSPEND,  // keep the machine awake
    CAP_BPF,            // programs in the kernel
    CAP_MAC_ADMIN,      // the policy of a security module
    CAP_MAC_OVERRIDE,   // no policy at all
    CAP_MKNOD,          // creating device files
    CAP_NET_ADMIN,      // interfaces, routes, packet filters
    CAP_PERFMON,        // counters and traces of every process
    CAP_SYSLOG,         // read and clear the kernel's log
    CAP_SYS_BOOT,       // power off, restart, load another kernel
    CAP_SYS_MODULE,     // load and unload kernel modules
    CAP_SYS_PACCT,      // process accounting
    CAP_SYS_RAWIO,      // ports and memory of the hardware
    CAP_SYS_TIME,       // set the clock
    CAP_SYS_TTY_CONFIG, // hang up the caller's terminal
    CAP_WAKE_ALARM,     // wake the machine
};

struct FreeCapabilities {
    void operator()(cap_t capabilities) const
    {
        cap_free(capabilities);
    }
};

struct ReleaseFilter {
    void operator()(scmp_filter_ctx filter) const
    {
        seccomp_release(filter);
    }
};

/** Throws for a negative result, as libseccomp has it. */
void checkFilter(int result)
{
    errno = -result;
    check(result < 0 ? -1 : 0, "cannot filter system calls");
}

} // namespace

void dropMachinePrivileges()
{
    std::unique_ptr<std::remove_pointer_t<cap_t>, FreeCapabilities> const own(cap_get_proc());
    if (!own)
        failed("cannot read the privileges");
    for (cap_value_t const privilege : machinePrivileges) {
        if (!CAP_IS_SUPPORTED(privilege))
            continue; // an older kernel
        check(cap_drop_bound(privilege), "cannot drop a privilege");
        for (cap_flag_t const set : {CAP_EFFECTIVE, CAP_PERMITTED, CAP_INHERITABLE})
            check(cap_set_flag(own.get(), set, 1, &privilege, CAP_CLEAR), "cannot drop privileges");
    }
    check(cap_set_proc(own.get()), "cannot drop privileges");
}

void refuseKernelsRecords()
{
    std::unique_ptr<void, ReleaseFilter> const filter(seccomp_init(SCMP_ACT_ALLOW));
    if (!filter)
        failed("cannot filter system calls");
    // Tools of the other word size, if the kernel runs them; otherwise refused.
    std::uint32_t const others[] = {SCMP_ARCH_X86_64, SCMP_ARCH_X86, SCMP_ARCH_X32};
    for (std::uint32_t const architecture : others)
        seccomp_arch_add(filter.get(), architecture);
    checkFilter(seccomp_attr_set(filter.get(), SCMP_FLTATR_ACT_BADARCH, SCMP_ACT_ALLOW));
    checkFilter(
        seccomp_attr_set(filter.get(), SCMP_FLTATR_CTL_NNP, 0)); // su and the like still work
    // Before Linux 6.8 CAP_SYS_ADMIN alone opens the kernel's log.
    checkFilter(seccomp_rule_add(filter.get(), SCMP_ACT_ERRNO(EPERM), SCMP_SYS(syslog), 0));
    checkFilter(seccomp_rule_add(filter.get(), SCMP_ACT_ERRNO(EAFNOSUPPORT), SCMP_SYS(socket), 2,
                                 SCMP_A0(SCMP_CMP_EQ, AF_NETLINK),
                                 SCMP_A2(SCMP_CMP_EQ, NETLINK_AUDIT)));
    checkFilter(seccomp_load(filter.get()));
}

} // namespace mihost
