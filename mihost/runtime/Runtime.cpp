#include "mihost/runtime/Runtime.h"

#include <atomic>

namespace mihost
{

namespace
{
std::atomic<NodeObserver*> observerInUse{nullptr};
}

void setNodeObserver(NodeObserver* observer)
{
    observerInUse.store(observer, std::memory_order_release);
}

NodeObserver* nodeObserver()
{
    return observerInUse.load(std::memory_order_acquire);
}

} // namespace mihost
