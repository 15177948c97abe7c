#ifndef FRAME_OSSWMI_H
#define FRAME_OSSWMI_H

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "host/Mutex.h"
#include "util/internal.h"
#include "util/log.h"

#include <memory>
#include <string>
#include <vector>

namespace IC
{

/**
 * The plug-in's interface object: builds the node tree and rebuilds parts of it.
 *
 * The framework owns every node built here. The pointers below are kept to find parents and to
 * remove the nodes of one kind on a rebuild.
 */
class OsSwMI : public ManagementInterface
{
public:
    OsSwMI();
    ~OsSwMI() override;

    /**
     * Prepares the framework and builds the whole tree, also when the framework fails.
     *
     * @return the framework's outcome
     */
    Error initialize(unsigned int first, Number const& second, Number const& third) override;

    /** Lets the framework delete the nodes, then frees the node-id list. */
    void unload() override;

    /** Makes one node known to the host; a refusal is logged and otherwise ignored. */
    void publishNode(Node* node);

    void createOsSwNodes();
    void createRootNode();
    void createComputerNodes();
    void createOsNodes();
    void createDriverNodes();

    /** @param refresh  delete the present nodes of this kind first and publish each new one */
    void createUserNodes(bool refresh);
    void createGroupNodes(bool refresh);

    void createLogNodes();
    void createLogEntryNodes(bool refresh);

protected:
    MutableNode* currentNode_ = nullptr; // the node being built
    // Contract: from initialize to unload; ids are appended, and nothing here reads them.
    std::vector<unsigned int>* nodeIds_ = nullptr;
    MutableNode* osSwNode_ = nullptr;
    MutableNode* rootNode_ = nullptr;
    MutableNode* computerNode_ = nullptr;
    MutableNode* osNode_ = nullptr;
    MutableNode* logNode_ = nullptr;
    std::vector<Node*> userNodes_;
    std::vector<Node*> groupNodes_;
    std::vector<Node*> logEntryNodes_;

private:
    /** Takes the next node id and notes it in the node-id list. */
    MI_INTERNAL unsigned int takeNodeId();

    /** Takes the next node id only. Contract: rebuilt user and group nodes are not noted. */
    MI_INTERNAL unsigned int takeUnnotedNodeId();

    /**
     * Makes a new node the current one and passes it to the framework.
     *
     * @param kin  the list to append it to; has room for it
     * @return the node, now owned by the framework
     */
    MI_INTERNAL MutableNode* adopt(std::unique_ptr<MutableNode> node,
                                   std::vector<Node*>* kin = nullptr);

    /** Gives the current node its status and its description. */
    MI_INTERNAL void setUp(std::string const& description);

    /** Empties a list of user or group nodes: announces each in the log and deletes it. */
    MI_INTERNAL void deleteNodes(std::vector<Node*>& nodes, char const* announcement,
                                 NQ::log::Scope const& scope);
};

/** The interface object that initialize ran on; node classes rebuild nodes through it. */
extern OsSwMI* pOsSwMI;

namespace OSSWMI
{

/** Logger category of the frame and of all nodes. */
extern std::string loggerOsSwMI;
extern OsSwMI myosswmi;
extern Error myerr;

/** Held for the whole of every build or rebuild of user or group nodes. */
extern NQ::Mutex myuserlock;

/** True while the user-node builder itself stores properties into user nodes. Not atomic. */
extern bool MI_call;

/** Where the frame's and the nodes' messages come from. */
extern NQ::log::Unit const unit MI_INTERNAL;

} // namespace OSSWMI

} // namespace IC

#endif
