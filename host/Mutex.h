#ifndef HOST_MUTEX_H
#define HOST_MUTEX_H

#include <memory>

namespace NQ
{

/**
 * A lock between threads, not recursive.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class Mutex
{
public:
    Mutex();
    ~Mutex();

    /**
     * @param timeout  milliseconds to wait; 0xFFFFFFFF and more wait without limit
     * @return 0 once the lock is held, non-zero if the time ran out
     */
    int lock(unsigned long timeout);

    /** @return 0 for success; the plug-in's getGroupInfo returns this number as its own result */
    int unlock();

private:
    Mutex(Mutex const&) = delete;
    Mutex& operator=(Mutex const&) = delete;

    struct Handle;
    std::unique_ptr<Handle> handle_; // private to the host; not part of the contract
};

} // namespace NQ

#endif
