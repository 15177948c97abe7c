#include "host/ManagementInterface.h"

#include "host/MutableNode.h"
#include "mihost/runtime/Runtime.h"

#include <algorithm>
#include <mutex>

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

/** Takes the node off the list, wherever it stands; the hint says where to look first. */
bool unlist(std::vector<Node*>& nodes, std::size_t& hint, Node* node)
{
    // Nodes of one kind are deleted in the order in which they stand, so the next one is mostly
    // where the last one was.
    if (hint >= nodes.size() || nodes[hint] != node) {
        auto const found = std::find(nodes.begin(), nodes.end(), node);
        if (found == nodes.end())
            return false;
        hint = static_cast<std::size_t>(found - nodes.begin());
    }
    nodes.erase(nodes.begin() + static_cast<std::ptrdiff_t>(hint));
    return true;
}

} // namespace

struct ManagementInterface::Own {
    // Guards the node list, for one look or one change at a time, since different threads may
    // rebuild nodes of different kinds at once. Nobody outside is called while it is held.
    std::mutex listLock;
    std::size_t deleteHint = 0; // where the last deleted node stood; the next one follows it
    AlertCallBack alertCallBack = nullptr;
    void const* alertContext = nullptr;
};

ManagementInterface::ManagementInterface()
    : nextNodeId_(0), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr), own_(std::make_unique<Own>())
{
}

ManagementInterface::~ManagementInterface() = default;

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
    std::lock_guard const held(own_->listLock);
    nodes = nodes_;
    return success();
}

Error ManagementInterface::initialize(unsigned int first, Number const&, Number const&)
{
    miId_ = first;
    miIds_.assign(1, first);
    nextNodeId_ = first + 1;
    return success();
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
        nodes.swap(nodes_);
        own_->deleteHint = 0;
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
        if (!unlist(nodes_, own_->deleteHint, node))
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
