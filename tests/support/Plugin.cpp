#include "tests/support/Plugin.h"

#include "TestPaths.h"

#include "host/OpenMI.h"
#include "host/Properties.h"
#include "tests/support/Symbols.h"

#include <algorithm>
#include <dlfcn.h>
#include <stdexcept>

Plugin::Plugin() : Plugin(PLUGIN_FILE) {}

Plugin::Plugin(char const* file) : library_(dlopen(file, RTLD_NOW | RTLD_LOCAL))
{
    if (!library_)
        throw std::runtime_error(dlerror());
    auto* const open = reinterpret_cast<decltype(&OpenMI)>(symbol("OpenMI"));
    if (!open || open(&interface_, &status_) != 0)
        throw std::runtime_error("OpenMI is missing or failed");
}

Plugin::~Plugin()
{
    if (initialized_)
        unload();
    dlclose(library_);
}

IC::ManagementInterface& Plugin::interface() const
{
    return *interface_;
}

IC::Error const& Plugin::status() const
{
    return *status_;
}

IC::Error Plugin::initialize(unsigned int first)
{
    initialized_ = true;
    return interface_->initialize(first, IC::Number(0U), IC::Number(0U));
}

void Plugin::unload()
{
    initialized_ = false;
    interface_->unload();
}

void* Plugin::symbol(std::string const& name) const
{
    void* const found = dlsym(library_, name.c_str());
    return found ? found : findSymbol(library_, name);
}

std::vector<IC::MutableNode*> Plugin::nodes() const
{
    std::vector<IC::Node*> all;
    interface_->getMap(all);
    std::vector<IC::MutableNode*> found(all.size());
    std::transform(all.begin(), all.end(), found.begin(),
                   [](IC::Node* node) { return dynamic_cast<IC::MutableNode*>(node); });
    return found;
}

std::vector<IC::MutableNode*> Plugin::nodes(unsigned int type) const
{
    std::vector<IC::MutableNode*> found;
    for (IC::MutableNode* node : nodes())
        if (node->getNodeType() == type)
            found.push_back(node);
    return found;
}

IC::MutableNode& Plugin::node(unsigned int type) const
{
    std::vector<IC::MutableNode*> const found = nodes(type);
    if (found.size() != 1)
        throw std::runtime_error(std::to_string(found.size()) + " nodes of type " +
                                 std::to_string(type));
    return *found.front();
}

IC::MutableNode* Plugin::find(unsigned int type, std::string const& name) const
{
    for (IC::MutableNode* node : nodes(type))
        if (stored(*node, IC::property::name) == name)
            return node;
    return nullptr;
}

IC::MutableNode& Plugin::node(unsigned int type, std::string const& name) const
{
    IC::MutableNode* const found = find(type, name);
    if (!found)
        throw std::runtime_error("no node of type " + std::to_string(type) + " is named " + name);
    return *found;
}

std::optional<IC::PropertyValue> property(IC::MutableNode const& node, unsigned int id)
{
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, false);
    if (node.getProperty(id, value).getStatus() != 0)
        return std::nullopt;
    return value;
}

std::string text(IC::MutableNode const& node, unsigned int id)
{
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, false);
    unsigned int const status = node.getProperty(id, value).getStatus();
    return status == 0 ? static_cast<std::string>(value)
                       : "(status " + std::to_string(status) + ")";
}

std::string stored(IC::MutableNode const& node, unsigned int id)
{
    auto const properties = node.getProperties();
    auto const found = properties.find(id);
    return found == properties.end() ? "(unset)" : static_cast<std::string>(found->second);
}
