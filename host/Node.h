#ifndef HOST_NODE_H
#define HOST_NODE_H

#include "host/Error.h"
#include "host/PropertyValue.h"

#include <map>
#include <memory>
#include <string>

namespace IC
{

/**
 * What a host sees of every node: a status, a description and numbered properties.
 *
 * The order of the virtual operations is part of the contract: one must not be moved, added or
 * taken away. Operations on different nodes may run in different threads. A host must not write
 * one node from two threads at once.
 */
class Node
{
public:
    virtual ~Node();
    virtual unsigned int getStatus() const;
    virtual std::string getDescription() const;

    /**
     * Reads one property.
     *
     * @param id     the property's number
     * @param value  receives the value; unchanged on failure
     * @return status 0, or non-zero if the property is not set
     */
    virtual Error getProperty(unsigned int id, PropertyValue& value) const;

    /** A copy of all stored values, by property id. Nothing is gathered live. */
    virtual std::map<unsigned int, PropertyValue> getProperties() const;

    /** Stores a value under its id in place of an earlier one. */
    virtual Error setProperty(unsigned int const& id, PropertyValue const& value);

    /** A short form for log messages. */
    virtual operator std::string() const;

protected:
    Node();

    struct Store;
    std::unique_ptr<Store> store_; // private to the host; not part of the contract

private:
    Node(Node const&) = delete;
    Node& operator=(Node const&) = delete;
};

} // namespace IC

#endif
