#ifndef HOST_MUTABLENODE_H
#define HOST_MUTABLENODE_H

#include "host/Node.h"

#include <memory>
#include <string>
#include <vector>

namespace IC
{

/**
 * The base of every node that a management interface builds.
 *
 * Interfaces create nodes with new and pass them to the framework, which owns them from then on.
 *
 * Contract: the plug-in creates and derives from objects of this class, so its size and the order
 * of its virtual operations are fixed, the first seven being those of Node; see OpenMI.h.
 */
class MutableNode : public Node
{
public:
    /**
     * @param nodeId    unique within the host
     * @param parentId  node id of the parent, 0 for none; what getLinkedId() returns
     * @param miIds     ids of the management interfaces that the node belongs to
     * @param nodeType  the node type id, one for each kind of node
     * @param index     0 for a single node, otherwise the running number among its kind from 1
     */
    MutableNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                unsigned int nodeType, unsigned int index);
    ~MutableNode() override;

    unsigned int getStatus() const override;
    std::string getDescription() const override;
    Error getProperty(unsigned int id, PropertyValue& value) const override;
    std::map<unsigned int, PropertyValue> getProperties() const override;
    Error setProperty(unsigned int const& id, PropertyValue const& value) override;

    virtual unsigned int getNodeId() const;
    virtual unsigned int getLinkedId() const;
    virtual unsigned int getIndex() const;
    virtual std::vector<unsigned int> getMIIds() const;
    virtual void addMI(unsigned int miId);
    virtual void delMI(unsigned int miId);
    virtual Error setStatus(unsigned int const& status);
    virtual Error setDescription(std::string const& description);
    virtual Error setPath(std::string const& path);
    virtual Error setParent(std::string const& parent);

    /** The node type id; not virtual, what a host reads. */
    unsigned int getNodeType() const;

private:
    struct Identity;
    std::unique_ptr<Identity> identity_; // private to the host; not part of the contract
};

} // namespace IC

#endif
