#include "mihost/runtime/NodeIndex.h"

#include <algorithm>

namespace mihost
{

void NodeIndex::catchUp(List const& list)
{
    if (indexed_ > list.size()) // nodes were removed by others
        reset();
    for (; indexed_ < list.size(); ++indexed_)
        if (list[indexed_])
            positions_.emplace(list[indexed_], indexed_);
}

void NodeIndex::closeGaps(List& list)
{
    list.erase(std::remove(list.begin(), list.end(), nullptr), list.end());
    for (std::size_t position = 0; position < list.size(); ++position)
        positions_[list[position]] = position;
    indexed_ = list.size();
}

bool NodeIndex::holds(List const& list, IC::Node const* node)
{
    catchUp(list);
    return positions_.count(node) != 0;
}

bool NodeIndex::remove(List& list, IC::Node const* node)
{
    catchUp(list);
    auto const found = positions_.find(node);
    if (found == positions_.end())
        return false;
    list[found->second] = nullptr;
    positions_.erase(found);
    if (list.size() > 2 * positions_.size())
        closeGaps(list);
    return true;
}

void NodeIndex::reset()
{
    positions_.clear();
    indexed_ = 0;
}

} // namespace mihost
