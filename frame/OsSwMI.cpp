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
    ManagementInterface::unload(); // deletes the nodes: a later life must not take others for them
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
        NQ::log::write(OSSWMI::unit, NQ::log::error,
                       NQ::log::message("addNewNode error = ", static_cast<std::string>(error)));
}

unsigned int OsSwMI::takeNodeId(bool note)
{
    if (note)
        nodeIds_->push_back(nextNodeId_);
    return nextNodeId_++;
}

MutableNode* OsSwMI::adopt(std::unique_ptr<MutableNode> node, std::vector<Node*>* kin)
{
    nodes_.push_back(nullptr); // may fail for want of memory, while the node is still ours
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

void OsSwMI::dropNodes(std::vector<Node*>& nodes, bool refresh, char const* announcement,
                       char const* function)
{
    std::vector<Node*> dropped;
    dropped.swap(nodes);
    if (!refresh)
        return;
    for (Node* node : dropped) {
        NQ::log::write(OSSWMI::unit, NQ::log::progress,
                       NQ::log::message(announcement, node->getDescription()), function);
        deleteNode(node);
    }
}

} // namespace IC
