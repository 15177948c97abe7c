#ifndef BENCH_PEERS_LOOPBACK_H
#define BENCH_PEERS_LOOPBACK_H

#include "mihost/sandbox/Descriptor.h"

/**
 * A network with only a loopback interface.
 *
 * Make it before entering the copy of the machine, in which networks cannot be changed.
 */
class Loopback
{
public:
    /** Keeps the process in its present network. @throws std::system_error */
    Loopback();

    /** Moves the process there; what it starts from now on cannot reach other machines. */
    void enter() const;

private:
    mihost::Descriptor network_;
};

#endif
