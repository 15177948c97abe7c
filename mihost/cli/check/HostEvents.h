#ifndef MIHOST_CLI_CHECK_HOSTEVENTS_H
#define MIHOST_CLI_CHECK_HOSTEVENTS_H

#include "host/ManagementInterface.h"
#include "mihost/runtime/Runtime.h"

#include <vector>

namespace mihost::checks
{

/** A node at the moment when the host was informed of it. */
struct SeenNode {
    IC::Node const* node; // to compare with; not to be followed once the node is deleted
    unsigned int id;
    unsigned int type;
};

/** Records the nodes that an interface publishes and deletes, and answers the load callback. */
class HostEvents : public NodeObserver
{
public:
    HostEvents();
    ~HostEvents() override;
    HostEvents(HostEvents const&) = delete;
    HostEvents& operator=(HostEvents const&) = delete;

    /** Makes this object the interface's load callback from now on. */
    void listenTo(IC::ManagementInterface& interface);

    /** Refuses every node from now on. */
    void refuse();

    void forget();

    /** What the load callback was called with. */
    std::vector<SeenNode> const& published() const
    {
        return published_;
    }
    std::vector<SeenNode> const& deleted() const
    {
        return deleted_;
    }

    void nodeAdded(IC::Node const&) override {}
    void nodeDeleted(IC::Node const& node) override;

private:
    static IC::Error load(IC::Node* const& node, void const* context);

    std::vector<SeenNode> published_;
    std::vector<SeenNode> deleted_;
    unsigned char answer_ = 0;
};

} // namespace mihost::checks

#endif
