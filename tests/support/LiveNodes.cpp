#include "tests/support/LiveNodes.h"

LiveNodes::LiveNodes(std::vector<IC::MutableNode*> const& nodes)
{
    for (IC::MutableNode const* node : nodes)
        nodes_.emplace(node, std::make_shared<std::mutex>());
    mihost::setNodeObserver(this);
}

LiveNodes::~LiveNodes()
{
    mihost::setNodeObserver(nullptr);
}

void LiveNodes::nodeAdded(IC::Node const& node)
{
    std::lock_guard const held(lock_);
    nodes_.emplace(&dynamic_cast<IC::MutableNode const&>(node), std::make_shared<std::mutex>());
}

void LiveNodes::nodeDeleted(IC::Node const& node)
{
    std::unique_lock held(lock_);
    auto const found = nodes_.find(&dynamic_cast<IC::MutableNode const&>(node));
    std::shared_ptr<std::mutex> const inUse = found->second;
    nodes_.erase(found); // no thread can begin to use it from here on
    held.unlock();
    std::lock_guard const waited(*inUse);
}

bool LiveNodes::use(unsigned int type, std::function<void(IC::MutableNode const& node)> const& with)
{
    std::unique_lock held(lock_);
    for (auto const& [node, inUse] : nodes_) {
        if (node->getNodeType() != type)
            continue;
        std::shared_ptr<std::mutex> const kept = inUse;
        std::unique_lock const used(*kept, std::try_to_lock);
        if (!used)
            continue;
        IC::MutableNode const& chosen = *node;
        held.unlock();
        with(chosen);
        return true;
    }
    return false;
}

void LiveNodes::useEach(std::function<void(IC::MutableNode const& node)> const& with)
{
    std::unique_lock held(lock_);
    Nodes const known = nodes_;
    held.unlock();
    for (auto const& [node, inUse] : known) {
        std::lock_guard const used(*inUse);
        held.lock();
        auto const found = nodes_.find(node);
        bool const lives = found != nodes_.end() && found->second == inUse;
        held.unlock();
        if (lives)
            with(*node);
    }
}

std::vector<IC::MutableNode const*> LiveNodes::ofType(unsigned int type) const
{
    std::lock_guard const held(lock_);
    std::vector<IC::MutableNode const*> found;
    for (auto const& entry : nodes_)
        if (entry.first->getNodeType() == type)
            found.push_back(entry.first);
    return found;
}
