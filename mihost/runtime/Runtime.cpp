#include "mihost/runtime/Runtime.h"

#include <atomic>

namespace mihost
{

namespace
{
std::atomic<NodeObserver*> observerInUse{nullptr};
std::atomic<IC::Error const*> initializeAnswerInUse{nullptr};
} // namespace

LogSink::~LogSink() = default;

NodeObserver::~NodeObserver() = default;

void setNodeObserver(NodeObserver* observer)
{
    observerInUse.store(observer, std::memory_order_release);
}

NodeObserver* nodeObserver()
{
    return observerInUse.load(std::memory_order_acquire);
}

void setInitializeAnswer(IC::Error const* answer)
{
    initializeAnswerInUse.store(answer, std::memory_order_release);
}

IC::Error const* initializeAnswer()
{
    return initializeAnswerInUse.load(std::memory_order_acquire);
}

} // namespace mihost
