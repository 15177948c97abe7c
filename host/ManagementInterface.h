#ifndef HOST_MANAGEMENTINTERFACE_H
#define HOST_MANAGEMENTINTERFACE_H

#include "host/Alert.h"
#include "host/Error.h"
#include "host/Node.h"
#include "host/Number.h"

#include <memory>
#include <string>
#include <vector>

namespace IC
{

/**
 * The object that a plug-in passes to its host, and the base class that the host provides for it.
 *
 * Lifecycle: the host gets it from OpenMI, may call setLoadCallBack, calls initialize once, uses
 * the tree, calls unload and then closes the library.
 *
 * Contract: the plug-in derives from this class, so the order of the virtual operations and of the
 * protected members is fixed; see OpenMI.h.
 */
class ManagementInterface
{
public:
    using AlertCallBack = Error (*)(std::vector<Alert> const& alerts, void const* context);
    using LoadCallBack = Error (*)(Node* const& node, void const* context);
    using LookupCallBack = Error (*)(std::string const& path, Node** node);

    ManagementInterface();

    /** Copies the list of the nodes. The nodes stay the framework's. */
    virtual Error getMap(std::vector<Node*>& nodes);

    /**
     * Prepares the interface.
     *
     * @param first   the interface's own id; node ids are counted from first + 1
     * @param second  for the framework; passed on unread
     * @param third   for the framework; passed on unread
     */
    virtual Error initialize(unsigned int first, Number const& second, Number const& third);

    virtual Error registerForAlerts(AlertCallBack callBack, void const* context);

    /**
     * Stores the callbacks that announce new nodes and find nodes by path. Calls neither.
     *
     * The nodes that initialize builds cause no call: take them from getMap. A rebuild passes each
     * of its new nodes to addNewNode, which calls once for each.
     */
    virtual void setLoadCallBack(LoadCallBack callBack, void const* context, LookupCallBack lookup)
    {
        loadCallBack_ = callBack;
        loadCallBackContext_ = context;
        lookupCallBack_ = lookup;
    }

    virtual Error deRegisterForAlerts();

    /** Deletes every node. */
    virtual void unload();

    virtual ~ManagementInterface();

    /** A short form for log messages. */
    virtual operator std::string() const;

    /**
     * Informs the host of a node through the load callback, and lists the node unless it is in the
     * list already.
     *
     * @return the callback's answer; on a non-zero status the node stays in the list
     */
    virtual Error addNewNode(Node*& node);

    /** Unlists the node, informs the host and deletes it. Status 1 for an unlisted node. */
    virtual Error deleteNode(Node* node);

    /** Finds a node by the text of its id. Status 1 if there is none. */
    virtual Error getNode(std::string const& id, Node*& node);

protected:
    unsigned int nextNodeId_;
    unsigned int miId_;
    // Owned; a management interface appends here directly and reads nothing here.
    std::vector<Node*> nodes_;
    std::vector<unsigned int> miIds_;
    LoadCallBack loadCallBack_;
    void const* loadCallBackContext_;
    LookupCallBack lookupCallBack_;

private:
    ManagementInterface(ManagementInterface const&) = delete;
    ManagementInterface& operator=(ManagementInterface const&) = delete;

    struct Own;
    std::unique_ptr<Own> own_; // private to the host; not part of the contract
};

} // namespace IC

#endif
