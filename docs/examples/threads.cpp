// Reads different nodes from different threads. Build with -pthread.

#include "load_plugin.h"

#include <atomic>
#include <iostream>
#include <thread>

int main(int argc, char** argv)
{
    LoadedPlugin plugin(argc > 1 ? argv[1] : "libzorvvxicosswmi.so.1");
    plugin.start();

    std::atomic<unsigned int> named{0};
    std::vector<std::thread> readers;
    for (IC::MutableNode const* node : plugin.nodes(IC::nodeType::user))
        readers.emplace_back([node, &named] {
            IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
            if (node->getProperty(IC::property::name, value).getStatus() == 0)
                ++named;
        });
    // No write until all readers are done: it would delete the nodes that they read.
    for (std::thread& reader : readers)
        reader.join();
    std::cout << "users with a name: " << named << " of " << readers.size() << '\n';
}
