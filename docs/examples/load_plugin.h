// Loads and unloads the plug-in, for the example programs.

#ifndef LOAD_PLUGIN_H
#define LOAD_PLUGIN_H

#include "host/MutableNode.h"
#include "host/OpenMI.h"
#include "host/Properties.h"

#include <dlfcn.h>

#include <stdexcept>
#include <vector>

class LoadedPlugin
{
public:
    explicit LoadedPlugin(char const* file) : library_(dlopen(file, RTLD_NOW))
    {
        void* const open = library_ ? dlsym(library_, "OpenMI") : nullptr;
        if (!open)
            throw std::runtime_error(dlerror());
        IC::Error* error = nullptr;
        reinterpret_cast<decltype(&OpenMI)>(open)(&interface_, &error);
    }

    ~LoadedPlugin()
    {
        interface_->unload(); // deletes the nodes, whose code is in the library
        dlclose(library_);
    }

    LoadedPlugin(LoadedPlugin const&) = delete;
    LoadedPlugin& operator=(LoadedPlugin const&) = delete;

    IC::ManagementInterface& interface()
    {
        return *interface_;
    }

    /** Builds the tree. */
    void start()
    {
        if (interface_->initialize(1, IC::Number(0U), IC::Number(0U)).getStatus() != 0)
            throw std::runtime_error("the plug-in did not start");
    }

    /** The nodes of one type, in the order of the tree; valid until the next write. */
    std::vector<IC::MutableNode*> nodes(unsigned int type)
    {
        std::vector<IC::Node*> all;
        interface_->getMap(all);
        std::vector<IC::MutableNode*> found;
        for (IC::Node* entry : all)
            if (auto* node = dynamic_cast<IC::MutableNode*>(entry); node->getNodeType() == type)
                found.push_back(node);
        return found;
    }

private:
    void* library_;
    IC::ManagementInterface* interface_ = nullptr;
};

#endif
