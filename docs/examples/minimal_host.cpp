// Loads the plug-in and prints its tree, indented by depth.

#include "host/MutableNode.h"
#include "host/OpenMI.h"

#include <dlfcn.h>

#include <iostream>
#include <map>

int main(int argc, char** argv)
{
    char const* const file = argc > 1 ? argv[1] : "libzorvvxicosswmi.so.1";
    void* const library = dlopen(file, RTLD_NOW);
    if (!library) {
        std::cerr << dlerror() << '\n';
        return 1;
    }
    auto const open = reinterpret_cast<decltype(&OpenMI)>(dlsym(library, "OpenMI"));
    IC::ManagementInterface* mi = nullptr;
    IC::Error* error = nullptr;
    if (!open || open(&mi, &error) != 0)
        return 1;

    unsigned int const ownId = 1;
    bool const started = mi->initialize(ownId, IC::Number(0U), IC::Number(0U)).getStatus() == 0;

    std::vector<IC::Node*> nodes;
    mi->getMap(nodes);
    std::map<unsigned int, std::size_t> depthOf; // parents come before their children
    for (IC::Node* entry : nodes) {
        auto const* node = dynamic_cast<IC::MutableNode*>(entry);
        std::size_t const depth = node->getLinkedId() == 0 ? 0 : depthOf[node->getLinkedId()] + 1;
        depthOf[node->getNodeId()] = depth;
        std::cout << std::string(2 * depth, ' ') << node->getNodeId() << ' '
                  << node->getDescription() << '\n';
    }

    mi->unload(); // deletes the nodes, whose code is in the library
    dlclose(library);
    return started ? 0 : 1;
}
