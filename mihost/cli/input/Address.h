#ifndef MIHOST_CLI_INPUT_ADDRESS_H
#define MIHOST_CLI_INPUT_ADDRESS_H

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <string>
#include <vector>

namespace mihost
{

/** A node as a person writes it: an id, or a kind and, for repeated kinds, a name. */
struct Address {
    NodeKind const* kind; // null if the node is given by id
    unsigned int id;      // valid only if kind is null
    std::string name;     // what follows the colon
};

/** @throws Failure saying what an address looks like */
Address parseAddress(std::string const& text);

/** The nodes in the order of the host's list. */
std::vector<IC::MutableNode*> nodesOf(IC::ManagementInterface& interface);

/** @throws Failure (NotFound) naming the address */
IC::MutableNode& findNode(std::vector<IC::MutableNode*> const& nodes, std::string const& address);

/** A stored property as text; empty if the node does not have it. */
std::string storedText(IC::MutableNode const& node, unsigned int property);

/** How a node is addressed: "os", "user:jdoe", or its id if its kind has no address. */
std::string addressOf(IC::MutableNode const& node);

} // namespace mihost

#endif
