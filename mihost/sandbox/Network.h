#ifndef MIHOST_SANDBOX_NETWORK_H
#define MIHOST_SANDBOX_NETWORK_H

namespace mihost
{

/**
 * Enables the only interface of a new network namespace, so that its processes can reach each
 * other. Does nothing without CAP_NET_ADMIN, as in a copy inside another.
 */
void startLoopback();

} // namespace mihost

#endif
