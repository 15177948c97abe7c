#include "host/Mutex.h"

#include <chrono>
#include <mutex>

namespace NQ
{

namespace
{
constexpr unsigned long withoutLimit = 0xFFFFFFFFUL;
}

struct [[gnu::visibility("hidden")]] Mutex::Handle
{
    std::timed_mutex mutex;
};

Mutex::Mutex() : handle_(std::make_unique<Handle>()) {}

Mutex::~Mutex() = default;

int Mutex::lock(unsigned long timeout)
{
    if (timeout >= withoutLimit) {
        handle_->mutex.lock();
        return 0;
    }
    return handle_->mutex.try_lock_for(std::chrono::milliseconds(timeout)) ? 0 : 1;
}

int Mutex::unlock()
{
    handle_->mutex.unlock();
    return 0;
}

} // namespace NQ
