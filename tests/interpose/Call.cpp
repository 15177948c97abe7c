#include "tests/interpose/Call.h"

namespace interpose
{

namespace
{

// Nothing here allocates: operator new is a replaced function, too.
AnyCall* last = nullptr;
thread_local unsigned int hooksRunning = 0;

AnyCall* put(AnyCall* call)
{
    return std::exchange(last, call);
}

} // namespace

AnyCall::AnyCall(char const* name) : name_(name), next_(put(this)) {}

char const* AnyCall::name() const
{
    return name_;
}

void AnyCall::failAt(unsigned long number)
{
    failing_ = number;
    made_ = 0;
    counting_ = true;
}

unsigned long AnyCall::stopCounting()
{
    counting_ = false;
    return made_;
}

bool AnyCall::failsNow()
{
    return counting_ && hooksRunning == 0 && ++made_ == failing_;
}

void AnyCall::reset()
{
    counting_ = false;
}

void resetAll()
{
    for (AnyCall* call = last; call; call = call->next_)
        call->reset();
}

InHook::InHook()
{
    ++hooksRunning;
}

InHook::~InHook()
{
    --hooksRunning;
}

} // namespace interpose
