#include "mihost/cli/check/Accounts.h"

#include "host/Properties.h"

#include <algorithm>
#include <iterator>

namespace mihost::checks
{

bool isAccount(unsigned int nodeType)
{
    return nodeType == IC::nodeType::user || nodeType == IC::nodeType::group;
}

Nodes accountsOf(Nodes const& nodes)
{
    Nodes accounts;
    std::copy_if(nodes.begin(), nodes.end(), std::back_inserter(accounts),
                 [](IC::MutableNode const* node) { return isAccount(node->getNodeType()); });
    return accounts;
}

IC::Error refresh(Subject& subject)
{
    return subject.os().setProperty(IC::property::refresh, IC::PropertyValue(IC::Number(0U), true));
}

} // namespace mihost::checks
