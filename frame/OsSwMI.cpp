#include "frame/OsSwMI.h"

#include "host/Properties.h"

namespace IC
{

OsSwMI::OsSwMI() = default;

OsSwMI::~OsSwMI() = default;

Error OsSwMI::initialize(unsigned int first, Number const& second, Number const& third)
{
    NQ::log::Scope const scope(OSSWMI::unit);
    pOsSwMI = this;
    nodeIds_ = new std::vector<unsigned int>;
    OSSWMI::myerr = ManagementInterface::initialize(first, second, third);
    currentNode_ = nullptr;
    // Each builder takes its parent from a node that an earlier one made.
    createOsSwNodes();
    createRootNode();
    createComputerNodes();
    createOsNodes();
    createDriverNodes();
    createUserNodes(false);
    createGroupNodes(false);
    createLogNodes();
    createLogEntryNodes(false);
    return OSSWMI::myerr;
}

void OsSwMI::unload()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    ManagementInterface::unload();
    // The nodes are deleted: a later initialize must not find their addresses here.
    for (std::vector<Node*>* kind : {&logEntryNodes_, &groupNodes_, &userNodes_})
        kind->clear();
    delete nodeIds_;
    nodeIds_ = nullptr;
}

void OsSwMI::publishNode(Node* node)
{
    NQ::log::Scope const scope(OSSWMI::unit);
    Error const error = addNewNode(node);
    if (error.getStatus() != 0)
        scope.error("addNewNode error = ", static_cast<std::string>(error));
}

unsigned int OsSwMI::takeNodeId()
{
    nodeIds_->push_back(nextNodeId_);
    return takeUnnotedNodeId();
}

unsigned int OsSwMI::takeUnnotedNodeId()
{
    return nextNodeId_++;
}

MutableNode* OsSwMI::adopt(std::unique_ptr<MutableNode> node, std::vector<Node*>* kin)
{
    nodes_.push_back(nullptr); // may run out of memory; the node is still ours
    currentNode_ = node.release();
    nodes_.back() = currentNode_;
    if (kin)
        kin->push_back(currentNode_);
    return currentNode_;
}

void OsSwMI::setUp(std::string const& description)
{
    currentNode_->setStatus(statusOk);
    currentNode_->setDescription(description);
}

void OsSwMI::deleteNodes(std::vector<Node*>& nodes, char const* announcement,
                         NQ::log::Scope const& scope)
{
    std::vector<Node*> deleted;
    deleted.swap(nodes);
    for (Node* node : deleted) {
        scope.progress(announcement, node->getDescription());
        deleteNode(node);
    }
}

} // namespace IC
