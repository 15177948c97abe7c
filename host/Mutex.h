#ifndef HOST_MUTEX_H
#define HOST_MUTEX_H

#include <memory>

namespace NQ
{

/** A lock between threads, not to be taken twice by the same thread. */
class Mutex
{
public:
    Mutex();
    ~Mutex();

    /**
     * @param timeout  milliseconds to wait; 0xFFFFFFFF and more wait without limit
     * @return 0 once the lock is held, non-zero where the time ran out
     */
    int lock(unsigned long timeout);

    /** @return 0 for success */
    int unlock();

private:
    Mutex(Mutex const&) = delete;
    Mutex& operator=(Mutex const&) = delete;

    struct Handle;
    std::unique_ptr<Handle> handle_; // the host's own
};

} // namespace NQ

#endif
