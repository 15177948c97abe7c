// Reads a live property, and the copy of it that was stored when the tree was built.

#include "load_plugin.h"

#include <iostream>

int main(int argc, char** argv)
{
    LoadedPlugin plugin(argc > 1 ? argv[1] : "libzorvvxicosswmi.so.1");
    plugin.start();
    IC::MutableNode const& os = *plugin.nodes(IC::nodeType::operatingSystem).front();

    IC::PropertyValue live(IC::PropertyValue::EmptyKind, true);
    if (os.getProperty(IC::property::physicalMemoryFree, live).getStatus() != 0)
        return 1;
    IC::PropertyValue const stored = os.getProperties().at(IC::property::physicalMemoryFree);
    std::cout << "free now: " << static_cast<std::string>(live) << " KiB\n"
              << "free at the start: " << static_cast<std::string>(stored) << " KiB\n";

    constexpr unsigned int noSuchProperty = 9999;
    IC::Error const error = os.getProperty(noSuchProperty, live);
    std::cout << "no such property: status " << int{error.getStatus()} << '\n';
}
