#ifndef TESTS_SUPPORT_FRAME_H
#define TESTS_SUPPORT_FRAME_H

#include "host/Properties.h"
#include "tests/interpose/Host.h"
#include "tests/support/Insides.h"
#include "tests/support/Shown.h"

#include <string>
#include <vector>

/**
 * The interface object for tests that are linked to the plug-in's objects.
 *
 * Its own id is 7. The builders have not run; an operating-system node with the id 8 is all that
 * there is of a tree.
 */
class Frame : public OpenInterface
{
public:
    Frame()
    {
        miId_ = 7;
        miIds_ = {7};
        nextNodeId_ = 8;
        nodeIds_ = new std::vector<unsigned int>;
        osNode_ =
            new IC::MutableNode(nextNodeId_++, miId_, miIds_, IC::nodeType::operatingSystem, 0);
        nodes_.push_back(osNode_);
        IC::pOsSwMI = this;
    }

    ~Frame() override
    {
        IC::pOsSwMI = nullptr;
        OsSwMI::unload();
    }

    IC::Error addNewNode(IC::Node*& node) override
    {
        published.push_back(node);
        return OsSwMI::addNewNode(node);
    }

    IC::Error deleteNode(IC::Node* node) override
    {
        deleted.push_back(node);
        return OsSwMI::deleteNode(node);
    }

    /** @return the nodes of one node type, in the order of the framework's list */
    std::vector<IC::MutableNode*> ofType(unsigned int type) const
    {
        std::vector<IC::MutableNode*> found;
        for (IC::Node* node : nodes_) {
            auto* const candidate = dynamic_cast<IC::MutableNode*>(node);
            if (candidate && candidate->getNodeType() == type)
                found.push_back(candidate);
        }
        return found;
    }

    /** The nodes that were published, and those whose deletion was requested. */
    std::vector<IC::Node*> published;
    std::vector<IC::Node*> deleted;
};

/**
 * Records the calls of the framework's node setters, in order, while it exists.
 *
 * Each call is a text such as "setStatus(1)", "setDescription(Driver)" or "setProperty(108)".
 */
class NodeCalls
{
public:
    NodeCalls()
    {
        host::hooks().setStatus.watch([this](IC::MutableNode*, unsigned int const& status) {
            calls.push_back("setStatus(" + std::to_string(status) + ")");
        });
        host::hooks().setDescription.watch(
            [this](IC::MutableNode*, std::string const& description) {
                calls.push_back("setDescription(" + description + ")");
            });
        host::hooks().setProperty.watch(
            [this](IC::MutableNode*, unsigned int const& id, IC::PropertyValue const&) {
                calls.push_back("setProperty(" + std::to_string(id) + ")");
            });
    }
    ~NodeCalls()
    {
        host::hooks().setStatus.reset();
        host::hooks().setDescription.reset();
        host::hooks().setProperty.reset();
    }
    NodeCalls(NodeCalls const&) = delete;
    NodeCalls& operator=(NodeCalls const&) = delete;

    std::vector<std::string> calls;
};

/**
 * A parent whose id shows when it is read: 1000 for each read so far, plus the interface's next
 * node id at that moment.
 */
class CountingParent : public IC::MutableNode
{
public:
    explicit CountingParent(Frame const& frame)
        : MutableNode(100, 0, {7}, IC::nodeType::operatingSystem, 0), frame_(frame)
    {
    }

    unsigned int getNodeId() const override
    {
        return 1000 * ++reads_ + frame_.nextNodeId_;
    }

    /** Whether each node read it once, after taking its own id. */
    static bool wasReadInOrder(std::vector<IC::MutableNode*> const& nodes)
    {
        unsigned int reads = 0;
        for (IC::MutableNode const* node : nodes)
            if (node->getLinkedId() != 1000 * ++reads + node->getNodeId() + 1)
                return false;
        return true;
    }

private:
    Frame const& frame_;
    mutable unsigned int reads_ = 0;
};

/** @return a stored property as shown() writes it; "unset" if there is none */
inline std::string storedValue(IC::Node const& node, unsigned int id)
{
    auto const properties = node.getProperties();
    auto const found = properties.find(id);
    return found == properties.end() ? "unset" : shown(found->second);
}

#endif
