#include "host/MutableNode.h"
#include "tests/hostcheck/other_host/Broken.h"

#include <algorithm>
#include <utility>

namespace IC
{

namespace
{

using Stored = std::pair<unsigned int, PropertyValue>;

Error done()
{
    return {0, Number(0U), ""};
}

bool comesBefore(Stored const& stored, unsigned int id)
{
    return stored.first < id;
}

} // namespace

// Properties in a vector, sorted by id.
struct Node::Store {
    unsigned int status = 0;
    std::string description;
    std::vector<Stored> properties;

    std::vector<Stored>::iterator place(unsigned int id)
    {
        return std::lower_bound(properties.begin(), properties.end(), id, comesBefore);
    }

    bool has(std::vector<Stored>::iterator at, unsigned int id) const
    {
        return at != properties.end() && at->first == id;
    }
};

Node::Node() : store_(new Store) {}

Node::~Node() = default;

unsigned int Node::getStatus() const
{
    return store_->status;
}

std::string Node::getDescription() const
{
    return store_->description;
}

Error Node::getProperty(unsigned int id, PropertyValue& value) const
{
    auto const at = store_->place(id);
    if (store_->has(at, id)) {
        value = at->second;
        return done();
    }
    if (broken(Way::UnsetClearsTheValue))
        value = PropertyValue(PropertyValue::EmptyKind, true);
    return {2, Number(id), "unset"};
}

std::map<unsigned int, PropertyValue> Node::getProperties() const
{
    return {store_->properties.begin(), store_->properties.end()};
}

Error Node::setProperty(unsigned int const& id, PropertyValue const& value)
{
    auto const at = store_->place(id);
    if (!store_->has(at, id))
        store_->properties.insert(at, {id, value});
    else if (!broken(Way::FirstValueStays))
        at->second = value;
    return done();
}

Node::operator std::string() const
{
    return "node '" + store_->description + "'";
}

struct MutableNode::Identity {
    unsigned int own;
    unsigned int parent;
    unsigned int type;
    unsigned int index;
    std::vector<unsigned int> interfaces;
    std::string path;
    std::string parentPath;
};

MutableNode::MutableNode(unsigned int nodeId, unsigned int parentId,
                         std::vector<unsigned int> miIds, unsigned int nodeType, unsigned int index)
    : identity_(new Identity{nodeId, parentId, nodeType, index, miIds, "", ""})
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
    static bool again = false;
    if (!broken(Way::BaseCallsDerived) || again)
        return Node::setProperty(id, value);
    again = true;
    Error const error = static_cast<Node*>(this)->setProperty(id, value);
    again = false;
    return error;
}

unsigned int MutableNode::getNodeId() const
{
    return identity_->own;
}

unsigned int MutableNode::getLinkedId() const
{
    return identity_->parent;
}

unsigned int MutableNode::getIndex() const
{
    return identity_->index;
}

std::vector<unsigned int> MutableNode::getMIIds() const
{
    return identity_->interfaces;
}

void MutableNode::addMI(unsigned int miId)
{
    identity_->interfaces.insert(identity_->interfaces.begin(), miId);
}

void MutableNode::delMI(unsigned int miId)
{
    auto& ids = identity_->interfaces;
    auto const at = std::find(ids.begin(), ids.end(), miId);
    if (at != ids.end() && !broken(Way::IdIsNotTakenAway))
        ids.erase(at);
}

Error MutableNode::setStatus(unsigned int const& status)
{
    store_->status = status;
    return done();
}

Error MutableNode::setDescription(std::string const& description)
{
    store_->description = description;
    return done();
}

Error MutableNode::setPath(std::string const& path)
{
    identity_->path = path;
    return done();
}

Error MutableNode::setParent(std::string const& parent)
{
    identity_->parentPath = parent;
    return done();
}

unsigned int MutableNode::getNodeType() const
{
    return identity_->type;
}

} // namespace IC
