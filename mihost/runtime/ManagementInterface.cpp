#include "host/ManagementInterface.h"

#include "host/MutableNode.h"
#include "mihost/runtime/NodeIndex.h"
#include "mihost/runtime/Outcome.h"
#include "mihost/runtime/Runtime.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <mutex>
#include <optional>

namespace IC
{

using mihost::failure;
using mihost::success;

struct [[gnu::visibility("hidden")]] ManagementInterface::Own
{
    // Guards the node list, for one look or one change at a time, since different threads may
    // rebuild nodes of different kinds at once. It is not held during calls to the outside.
    std::mutex listLock;
    mihost::NodeIndex index;
    AlertCallBack alertCallBack = nullptr;
    void const* alertContext = nullptr;
};

namespace
{

/** The nodes of a list, without the gaps that removed ones left. */
std::vector<Node*> withoutGaps(std::vector<Node*> const& list)
{
    std::vector<Node*> nodes;
    nodes.reserve(list.size());
    std::copy_if(list.begin(), list.end(), std::back_inserter(nodes),
                 [](Node const* node) { return node != nullptr; });
    return nodes;
}

/** The number that a text is the plain decimal form of. */
std::optional<unsigned int> numberIn(std::string const& text)
{
    unsigned int number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return std::to_string(number) == text ? std::optional(number) : std::nullopt;
}

} // namespace

ManagementInterface::ManagementInterface()
    : nextNodeId_(0), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr), own_(std::make_unique<Own>())
{
}

ManagementInterface::~ManagementInterface() = default;

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
    std::lock_guard const held(own_->listLock);
    nodes = withoutGaps(nodes_);
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
        nodes = withoutGaps(nodes_);
        nodes_.clear();
        own_->index.reset();
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
        if (!own_->index.holds(nodes_, node))
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
        if (!own_->index.remove(nodes_, node))
            return failure("no such node");
    }
    if (mihost::NodeObserver* observer = mihost::nodeObserver())
        observer->nodeDeleted(*node);
    delete node;
    return success();
}

Error ManagementInterface::getNode(std::string const& id, Node*& node)
{
    std::optional<unsigned int> const number = numberIn(id);
    std::lock_guard const held(own_->listLock);
    auto const found = std::find_if(nodes_.begin(), nodes_.end(), [number](Node* candidate) {
        auto const* mutableNode = dynamic_cast<MutableNode const*>(candidate);
        return mutableNode && mutableNode->getNodeId() == number;
    });
    if (found == nodes_.end())
        return failure("no node has the id " + id);
    node = *found;
    return success();
}

} // namespace IC
