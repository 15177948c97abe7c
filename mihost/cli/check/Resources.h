#ifndef MIHOST_CLI_CHECK_RESOURCES_H
#define MIHOST_CLI_CHECK_RESOURCES_H

#include <cstddef>

namespace mihost::checks
{

/** The resources of a process that a plug-in may leak. */
struct Resources {
    std::size_t descriptors; // open
    std::size_t threads;
    std::size_t heap; // bytes allocated; 0 if the allocator does not say
    bool children;    // whether there are any, running, or ended and not waited for
};

Resources resourcesInUse();

} // namespace mihost::checks

#endif
