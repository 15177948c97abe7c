#ifndef BENCH_PEERS_LOOPBACK_H
#define BENCH_PEERS_LOOPBACK_H

#include "mihost/sandbox/Descriptor.h"

/**
 * A network with nothing in it but its own loopback.
 *
 * To be made before the copy of the machine is entered, which may not change networks.
 */
class Loopback
{
public:
    /** Keeps the process in its present network. @throws std::system_error */
    Loopback();

    /** Takes the process there; what it starts from now on reaches nobody outside. */
    void enter() const;

private:
    mihost::Descriptor network_;
};

#endif
