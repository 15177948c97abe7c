// Reads different nodes from different threads. Build with -pthread.

#include "load_plugin.h"

#include <atomic>
#include <iostream>
#include <thread>

constexpr unsigned int name = 108;

int main(int argc, char** argv)
{
    LoadedPlugin plugin(argc > 1 ? argv[1] : "libzorvvxicosswmi.so.1");
    plugin.start();

    std::atomic<unsigned int> named{0};
    std::vector<std::thread> readers;
    for (IC::MutableNode const* node : plugin.nodes(userType))
        readers.emplace_back([node, &named] {
            IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
            if (node->getProperty(name, value).getStatus() == 0)
                ++named;
        });
    // No write until all readers are done: it would delete the nodes that they read.
    for (std::thread& reader : readers)
        reader.join();
    std::cout << "users with a name: " << named << " of " << readers.size() << '\n';
}
