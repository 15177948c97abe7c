#include "host/ManagementInterface.h"

#include "host/MutableNode.h"
#include "mihost/runtime/Runtime.h"

#include <algorithm>
#include <mutex>
#include <unordered_map>

namespace IC
{

namespace
{

Error success()
{
    return {0, Number(0U), ""};
}

Error failure(std::string const& reason)
{
    return {1, Number(Number::EmptyKind), reason};
}

} // namespace

struct ManagementInterface::Own {
    // Guards the node list, for one look or one change at a time, since different threads may
    // rebuild nodes of different kinds at once. Nobody outside is called while it is held.
    std::mutex listLock;
    // Where each node is in the list, up to that position. Deleted nodes leave null pointers until
    // the next look: closing each gap at once would cost a rebuild the square of the nodes.
    std::unordered_map<Node const*, std::size_t> positions;
    std::size_t indexed = 0;
    AlertCallBack alertCallBack = nullptr;
    void const* alertContext = nullptr;

    bool unlist(std::vector<Node*>& nodes, Node const* node);
    void closeGaps(std::vector<Node*>& nodes);
};

bool ManagementInterface::Own::unlist(std::vector<Node*>& nodes, Node const* node)
{
    for (; indexed < nodes.size(); ++indexed)
        positions[nodes[indexed]] = indexed;
    auto const found = positions.find(node);
    if (!node || found == positions.end())
        return false;
    nodes[found->second] = nullptr;
    positions.erase(found);
    return true;
}

void ManagementInterface::Own::closeGaps(std::vector<Node*>& nodes)
{
    if (indexed == 0) // nothing was deleted since
        return;
    nodes.erase(std::remove(nodes.begin(), nodes.end(), nullptr), nodes.end());
    positions.clear();
    indexed = 0;
}

ManagementInterface::ManagementInterface()
    : nextNodeId_(0), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr), own_(std::make_unique<Own>())
{
}

ManagementInterface::~ManagementInterface() = default;

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
    std::lock_guard const held(own_->listLock);
    own_->closeGaps(nodes_);
    nodes = nodes_;
    return success();
}

Error ManagementInterface::initialize(unsigned int first, Number const&, Number const&)
{
    miId_ = first;
    miIds_.assign(1, first);
    nextNodeId_ = first + 1;
    Error const* const answer = mihost::initializeAnswer();
    return answer ? *answer : success();
}

Error ManagementInterface::registerForAlerts(AlertCallBack callBack, void const* context)
{
    own_->alertCallBack = callBack;
    own_->alertContext = context;
    return success();
}

Error ManagementInterface::deRegisterForAlerts()
{
    return registerForAlerts(nullptr, nullptr);
}

void ManagementInterface::unload()
{
    std::vector<Node*> nodes;
    {
        std::lock_guard const held(own_->listLock);
        own_->closeGaps(nodes_);
        nodes.swap(nodes_);
    }
    for (Node* node : nodes)
        delete node;
}

ManagementInterface::operator std::string() const
{
    return "management interface " + std::to_string(miId_);
}

Error ManagementInterface::addNewNode(Node*& node)
{
    if (!node)
        return failure("no node given");
    {
        std::lock_guard const held(own_->listLock);
        own_->closeGaps(nodes_);
        // A node just built stands at the end of the list, so the search starts there.
        if (std::find(nodes_.rbegin(), nodes_.rend(), node) == nodes_.rend())
            nodes_.push_back(node);
    }
    if (mihost::NodeObserver* observer = mihost::nodeObserver())
        observer->nodeAdded(*node);
    return loadCallBack_ ? loadCallBack_(node, loadCallBackContext_) : success();
}

Error ManagementInterface::deleteNode(Node* node)
{
    {
        std::lock_guard const held(own_->listLock);
        if (!own_->unlist(nodes_, node))
            return failure("no such node");
    }
    if (mihost::NodeObserver* observer = mihost::nodeObserver())
        observer->nodeDeleted(*node);
    delete node;
    return success();
}

Error ManagementInterface::getNode(std::string const& id, Node*& node)
{
    std::lock_guard const held(own_->listLock);
    auto const found = std::find_if(nodes_.begin(), nodes_.end(), [&id](Node* candidate) {
        auto const* mutableNode = dynamic_cast<MutableNode const*>(candidate);
        return mutableNode && std::to_string(mutableNode->getNodeId()) == id;
    });
    if (found == nodes_.end())
        return failure("no node has the id " + id);
    node = *found;
    return success();
}

} // namespace IC
