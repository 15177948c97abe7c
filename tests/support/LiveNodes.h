#ifndef TESTS_SUPPORT_LIVENODES_H
#define TESTS_SUPPORT_LIVENODES_H

#include "host/MutableNode.h"
#include "mihost/runtime/Runtime.h"

#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <vector>

/**
 * The nodes that exist, for a host with several threads: no node is deleted while one of them uses
 * it.
 *
 * It is informed of new and deleted nodes while it exists.
 */
class LiveNodes : public mihost::NodeObserver
{
public:
    /** @param nodes  those that exist already */
    explicit LiveNodes(std::vector<IC::MutableNode*> const& nodes);
    ~LiveNodes() override;

    void nodeAdded(IC::Node const& node) override;
    void nodeDeleted(IC::Node const& node) override;

    /** Uses a node of the type that no other thread uses. @return false if there is none now */
    bool use(unsigned int type, std::function<void(IC::MutableNode const& node)> const& with);

    /** Uses all nodes, one after the other; waits for those that other threads use. */
    void useEach(std::function<void(IC::MutableNode const& node)> const& with);

    std::vector<IC::MutableNode const*> ofType(unsigned int type) const;

private:
    using Nodes = std::map<IC::MutableNode const*, std::shared_ptr<std::mutex>>;

    Nodes nodes_;
    mutable std::mutex lock_;
};

#endif
