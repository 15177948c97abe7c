#ifndef MIHOST_RUNTIME_NODEINDEX_H
#define MIHOST_RUNTIME_NODEINDEX_H

#include <cstddef>
#include <unordered_map>
#include <vector>

namespace IC
{
class Node;
}

namespace mihost
{

/**
 * The position of each node in the node list of an interface, which appends to the list itself.
 *
 * A removed node leaves a null pointer in the list. These gaps are closed once they outnumber the
 * nodes, so that a removal takes constant time.
 */
class [[gnu::visibility("hidden")]] NodeIndex
{
public:
    using List = std::vector<IC::Node*>;

    bool holds(List const& list, IC::Node const* node);

    /** Removes a node from the list. @return false if it is not in the list */
    bool remove(List & list, IC::Node const* node);

    /** Forgets all positions: the list was emptied. */
    void reset();

private:
    /** Records the positions of what the interface appended since the last call. */
    void catchUp(List const& list);
    void closeGaps(List & list);

    std::unordered_map<IC::Node const*, std::size_t> positions_;
    std::size_t indexed_ = 0; // indexed entries of the list, gaps included
};

} // namespace mihost

#endif
