// Rebuilds users and groups, and counts the new nodes through the load callback.

#include "load_plugin.h"

#include <iostream>

IC::Error count(IC::Node* const&, void const* context)
{
    ++*static_cast<unsigned int*>(const_cast<void*>(context));
    return {0, IC::Number(0U), ""}; // any other status is logged as a refusal; the node stays
}

int main(int argc, char** argv)
{
    LoadedPlugin plugin(argc > 1 ? argv[1] : "libzorvvxicosswmi.so.1");
    unsigned int calls = 0;
    plugin.interface().setLoadCallBack(count, &calls, nullptr);
    plugin.start();
    std::cout << "calls at the start: " << calls << '\n';

    // The operating-system node stays; user and group nodes are replaced.
    IC::MutableNode& os = *plugin.nodes(IC::nodeType::operatingSystem).front();
    os.setProperty(IC::property::refresh,
                   IC::PropertyValue(IC::Number(IC::command::rebuild), true));
    std::cout << "calls of the rebuild: " << calls << '\n'
              << "users now: " << plugin.nodes(IC::nodeType::user).size() << '\n';
}
