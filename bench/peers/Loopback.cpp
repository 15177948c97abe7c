#include "bench/peers/Loopback.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <net/if.h>
#include <sched.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <system_error>

namespace
{

void check(int result, char const* what)
{
    if (result < 0)
        throw std::system_error(errno, std::generic_category(), what);
}

mihost::Descriptor ownNetwork()
{
    mihost::Descriptor network(open("/proc/self/ns/net", O_RDONLY | O_CLOEXEC));
    check(network.get(), "cannot open the network");
    return network;
}

void turnOnLoopback()
{
    mihost::Descriptor const socket(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    check(socket.get(), "cannot make a socket");
    ifreq request{};
    std::strcpy(request.ifr_name, "lo");
    check(ioctl(socket.get(), SIOCGIFFLAGS, &request), "cannot read the loopback's state");
    request.ifr_flags = static_cast<short>(request.ifr_flags | IFF_UP);
    check(ioctl(socket.get(), SIOCSIFFLAGS, &request), "cannot turn the loopback on");
}

} // namespace

Loopback::Loopback()
{
    mihost::Descriptor const before = ownNetwork();
    check(unshare(CLONE_NEWNET), "cannot make a network");
    turnOnLoopback();
    network_ = ownNetwork();
    check(setns(before.get(), CLONE_NEWNET), "cannot go back to the network");
}

void Loopback::enter() const
{
    check(setns(network_.get(), CLONE_NEWNET), "cannot enter the network");
}
