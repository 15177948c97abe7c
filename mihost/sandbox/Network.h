#ifndef MIHOST_SANDBOX_NETWORK_H
#define MIHOST_SANDBOX_NETWORK_H

namespace mihost
{

/**
 * Turns on the only interface of a new network namespace, so that what runs there can talk to
 * itself. It stays off where CAP_NET_ADMIN is missing, as in a copy made inside another.
 */
void startLoopback();

} // namespace mihost

#endif
