#include "mihost/sandbox/Network.h"

#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/SystemCall.h"

#include <cstring>
#include <net/if.h>
#include <sys/ioctl.h>
#include <sys/socket.h>

namespace mihost
{

void startLoopback()
{
    Descriptor const socket(
        check(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0), "cannot create a socket"));
    ifreq request{};
    std::strcpy(request.ifr_name, "lo");
    request.ifr_flags = IFF_UP;
    if (ioctl(socket.get(), SIOCSIFFLAGS, &request) != 0 && errno != EPERM)
        failed("cannot start the loopback interface");
}

} // namespace mihost
