#ifndef TESTS_INTERPOSE_ALLOCATION_H
#define TESTS_INTERPOSE_ALLOCATION_H

#include "tests/interpose/Call.h"

namespace interpose
{

/** operator new, which throws std::bad_alloc when it is made to fail. */
AnyCall& allocation();

} // namespace interpose

#endif
