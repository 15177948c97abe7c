#include "host/ManagementInterface.h"

#include "host/MutableNode.h"
#include "mihost/runtime/Runtime.h"

#include <algorithm>

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

ManagementInterface::ManagementInterface()
    : nextNodeId_(0), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr), alertCallBack_(nullptr), alertContext_(nullptr), deleteHint_(0)
{
}

ManagementInterface::~ManagementInterface() = default;

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
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
    alertCallBack_ = callBack;
    alertContext_ = context;
    return success();
}

Error ManagementInterface::deRegisterForAlerts()
{
    return registerForAlerts(nullptr, nullptr);
}

void ManagementInterface::unload()
{
    std::vector<Node*> nodes;
    nodes.swap(nodes_);
    deleteHint_ = 0;
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
    // A node just built stands at the end of the list, so the search starts there.
    if (std::find(nodes_.rbegin(), nodes_.rend(), node) == nodes_.rend())
        nodes_.push_back(node);
    if (mihost::NodeObserver* observer = mihost::nodeObserver())
        observer->nodeAdded(*node);
    return loadCallBack_ ? loadCallBack_(node, loadCallBackContext_) : success();
}

Error ManagementInterface::deleteNode(Node* node)
{
    // Nodes of one kind are deleted in the order in which they stand, so the next one is mostly
    // where the last one was.
    if (deleteHint_ >= nodes_.size() || nodes_[deleteHint_] != node) {
        auto const found = std::find(nodes_.begin(), nodes_.end(), node);
        if (found == nodes_.end())
            return failure("no such node");
        deleteHint_ = static_cast<std::size_t>(found - nodes_.begin());
    }
    nodes_.erase(nodes_.begin() + static_cast<std::ptrdiff_t>(deleteHint_));
    if (mihost::NodeObserver* observer = mihost::nodeObserver())
        observer->nodeDeleted(*node);
    delete node;
    return success();
}

Error ManagementInterface::getNode(std::string const& id, Node*& node)
{
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
