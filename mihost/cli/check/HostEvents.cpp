#include "mihost/cli/check/HostEvents.h"

#include "host/MutableNode.h"

namespace mihost::checks
{

namespace
{

SeenNode seen(IC::Node const& node)
{
    auto const* const known = dynamic_cast<IC::MutableNode const*>(&node);
    return {&node, known ? known->getNodeId() : 0, known ? known->getNodeType() : 0};
}

} // namespace

HostEvents::HostEvents()
{
    setNodeObserver(this);
}

HostEvents::~HostEvents()
{
    setNodeObserver(nullptr);
}

void HostEvents::listenTo(IC::ManagementInterface& interface)
{
    interface.setLoadCallBack(load, this, nullptr);
}

void HostEvents::refuse()
{
    answer_ = 1;
}

void HostEvents::forget()
{
    published_.clear();
    deleted_.clear();
}

void HostEvents::nodeDeleted(IC::Node const& node)
{
    deleted_.push_back(seen(node));
}

IC::Error HostEvents::load(IC::Node* const& node, void const* context)
{
    // The contract passes the context as constant; it is ours.
    auto& events = *static_cast<HostEvents*>(const_cast<void*>(context));
    if (node)
        events.published_.push_back(seen(*node));
    return {events.answer_, IC::Number(IC::Number::EmptyKind),
            events.answer_ == 0 ? "" : "refused by the check"};
}

} // namespace mihost::checks
