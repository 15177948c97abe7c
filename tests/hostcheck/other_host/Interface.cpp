#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "tests/hostcheck/other_host/Broken.h"

#include <algorithm>
#include <list>

namespace IC
{

namespace
{

Error result(unsigned char status)
{
    return {status, Number(Number::EmptyKind), status == 0 ? "" : "unknown node"};
}

} // namespace

// A linked list of nodes; nodes_ is where new ones arrive.
struct ManagementInterface::Own {
    std::list<Node*> nodes;

    void take(std::vector<Node*>& arrived)
    {
        nodes.insert(nodes.end(), arrived.begin(), arrived.end());
        arrived.clear();
    }

    std::list<Node*>::iterator placeOf(Node const* node)
    {
        auto const at = std::find(nodes.rbegin(), nodes.rend(), node);
        return at == nodes.rend() ? nodes.end() : std::prev(at.base());
    }
};

ManagementInterface::ManagementInterface()
    : nextNodeId_(1), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr), own_(new Own)
{
}

ManagementInterface::~ManagementInterface() = default;

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
    own_->take(nodes_);
    nodes.assign(own_->nodes.begin(), own_->nodes.end());
    return result(0);
}

Error ManagementInterface::initialize(unsigned int first, Number const&, Number const&)
{
    miId_ = first;
    miIds_ = {first};
    nextNodeId_ = broken(Way::CountsFromItsOwnId) ? first : first + 1;
    return result(0);
}

Error ManagementInterface::registerForAlerts(AlertCallBack, void const*)
{
    return result(0);
}

Error ManagementInterface::deRegisterForAlerts()
{
    return result(0);
}

void ManagementInterface::unload()
{
    own_->take(nodes_);
    if (!broken(Way::UnloadKeepsNodes))
        for (Node* node : own_->nodes)
            delete node;
    own_->nodes.clear();
}

ManagementInterface::operator std::string() const
{
    return "interface";
}

Error ManagementInterface::addNewNode(Node*& node)
{
    own_->take(nodes_);
    if (own_->placeOf(node) == own_->nodes.end() || broken(Way::ListsTwice))
        own_->nodes.push_back(node);
    if (!loadCallBack_)
        return result(0);
    Error const answer = loadCallBack_(node, loadCallBackContext_);
    if (broken(Way::CallsBackTwice))
        loadCallBack_(node, loadCallBackContext_);
    return broken(Way::AnswerIsDropped) ? result(0) : answer;
}

Error ManagementInterface::deleteNode(Node* node)
{
    own_->take(nodes_);
    auto const at = own_->placeOf(node);
    if (at == own_->nodes.end())
        return result(broken(Way::UnlistedIsDeleted) ? 0 : 1);
    own_->nodes.erase(at);
    if (!broken(Way::NodeIsNotDeleted))
        delete node;
    return result(0);
}

Error ManagementInterface::getNode(std::string const& id, Node*& node)
{
    own_->take(nodes_);
    for (Node* candidate : own_->nodes) {
        // Interfaces build no other nodes. A dynamic_cast would need this file's type information.
        if (std::to_string(static_cast<MutableNode*>(candidate)->getNodeId()) != id)
            continue;
        node = candidate;
        return result(0);
    }
    return result(1);
}

} // namespace IC
