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
 * A host's view of the nodes that are alive: no node goes while one of its threads is using it.
 *
 * Told of new and deleted nodes for as long as it lives.
 */
class LiveNodes : public mihost::NodeObserver
{
public:
    /** @param nodes  those that are alive already */
    explicit LiveNodes(std::vector<IC::MutableNode*> const& nodes);
    ~LiveNodes() override;

    void nodeAdded(IC::Node const& node) override;
    void nodeDeleted(IC::Node const& node) override;

    /** Uses some node of the type that nobody else is using; false where there is none now. */
    bool use(unsigned int type, std::function<void(IC::MutableNode const& node)> const& with);

    /** Uses all nodes that are alive, one after the other; waits for those that others are using.
     */
    void useEach(std::function<void(IC::MutableNode const& node)> const& with);

    std::vector<IC::MutableNode const*> ofType(unsigned int type) const;

private:
    using Nodes = std::map<IC::MutableNode const*, std::shared_ptr<std::mutex>>;

    Nodes nodes_;
    mutable std::mutex lock_;
};

#endif
