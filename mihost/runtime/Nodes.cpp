#include "host/MutableNode.h"
#include "host/Node.h"
#include "mihost/runtime/Outcome.h"

#include <algorithm>
#include <mutex>
#include <utility>

namespace IC
{

using mihost::failure;
using mihost::success;

// The lock is held for one lookup or one store only, and nothing is called while it is held.
struct [[gnu::visibility("hidden")]] Node::Store
{
    mutable std::mutex lock;
    unsigned int status = 0;
    std::string description;
    std::map<unsigned int, PropertyValue> properties;
};

Node::Node() : store_(std::make_unique<Store>()) {}

Node::~Node() = default;

unsigned int Node::getStatus() const
{
    std::lock_guard const held(store_->lock);
    return store_->status;
}

std::string Node::getDescription() const
{
    std::lock_guard const held(store_->lock);
    return store_->description;
}

Error Node::getProperty(unsigned int id, PropertyValue& value) const
{
    std::lock_guard const held(store_->lock);
    auto const found = store_->properties.find(id);
    if (found == store_->properties.end())
        return failure("property " + std::to_string(id) + " is not set");
    value = found->second;
    return success();
}

std::map<unsigned int, PropertyValue> Node::getProperties() const
{
    std::lock_guard const held(store_->lock);
    return store_->properties;
}

Error Node::setProperty(unsigned int const& id, PropertyValue const& value)
{
    std::lock_guard const held(store_->lock);
    store_->properties.insert_or_assign(id, value);
    return success();
}

Node::operator std::string() const
{
    return getDescription();
}

struct [[gnu::visibility("hidden")]] MutableNode::Identity
{
    unsigned int nodeId;
    unsigned int parentId;
    std::vector<unsigned int> miIds;
    unsigned int nodeType;
    unsigned int index;
    std::string path;
    std::string parent;
};

MutableNode::MutableNode(unsigned int nodeId, unsigned int parentId,
                         std::vector<unsigned int> miIds, unsigned int nodeType, unsigned int index)
    : identity_(std::make_unique<Identity>(
          Identity{nodeId, parentId, std::move(miIds), nodeType, index, "", ""}))
{
}

MutableNode::~MutableNode() = default;

unsigned int MutableNode::getStatus() const
{
    return Node::getStatus();
}

std::string MutableNode::getDescription() const
{
    return Node::getDescription();
}

Error MutableNode::getProperty(unsigned int id, PropertyValue& value) const
{
    return Node::getProperty(id, value);
}

std::map<unsigned int, PropertyValue> MutableNode::getProperties() const
{
    return Node::getProperties();
}

Error MutableNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    return Node::setProperty(id, value);
}

unsigned int MutableNode::getNodeId() const
{
    return identity_->nodeId;
}

unsigned int MutableNode::getLinkedId() const
{
    return identity_->parentId;
}

unsigned int MutableNode::getIndex() const
{
    return identity_->index;
}

std::vector<unsigned int> MutableNode::getMIIds() const
{
    std::lock_guard const held(store_->lock);
    return identity_->miIds;
}

void MutableNode::addMI(unsigned int miId)
{
    std::lock_guard const held(store_->lock);
    auto& ids = identity_->miIds;
    if (std::find(ids.begin(), ids.end(), miId) == ids.end())
        ids.push_back(miId);
}

void MutableNode::delMI(unsigned int miId)
{
    std::lock_guard const held(store_->lock);
    auto& ids = identity_->miIds;
    ids.erase(std::remove(ids.begin(), ids.end(), miId), ids.end());
}

Error MutableNode::setStatus(unsigned int const& status)
{
    std::lock_guard const held(store_->lock);
    store_->status = status;
    return success();
}

Error MutableNode::setDescription(std::string const& description)
{
    std::lock_guard const held(store_->lock);
    store_->description = description;
    return success();
}

Error MutableNode::setPath(std::string const& path)
{
    std::lock_guard const held(store_->lock);
    identity_->path = path;
    return success();
}

Error MutableNode::setParent(std::string const& parent)
{
    std::lock_guard const held(store_->lock);
    identity_->parent = parent;
    return success();
}

unsigned int MutableNode::getNodeType() const
{
    return identity_->nodeType;
}

} // namespace IC
