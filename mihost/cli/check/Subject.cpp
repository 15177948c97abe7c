#include "mihost/cli/check/Subject.h"

#include "host/Properties.h"
#include "mihost/cli/input/Address.h"

#include <stdexcept>
#include <utility>

namespace mihost::checks
{

Subject::Subject(std::string file, unsigned int rounds) : file_(std::move(file)), rounds_(rounds) {}

Plugin& Subject::plugin()
{
    if (!plugin_)
        plugin_ = std::make_unique<Plugin>(file_);
    return *plugin_;
}

IC::Error Subject::initialize()
{
    events_.listenTo(interface());
    return interface().initialize(ownId, IC::Number(0U), IC::Number(0U));
}

void Subject::unload()
{
    interface().unload();
}

void Subject::close()
{
    plugin_.reset();
}

Nodes Subject::nodes()
{
    return nodesOf(interface());
}

IC::MutableNode& Subject::os()
{
    for (IC::MutableNode* node : nodes())
        if (node->getNodeType() == IC::nodeType::operatingSystem)
            return *node;
    throw std::runtime_error("there is no operating-system node");
}

} // namespace mihost::checks
