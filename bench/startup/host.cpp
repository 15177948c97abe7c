// startup_host PLUGIN [READS [LIST]]: starts the plug-in as a host does, without a log, and prints
// the processor time that it took itself, in microseconds. Then reads the newest log entry's
// message once and READS times more, and prints the mean time of each kind of read, in
// microseconds. If a file is given, writes every command of the start to it, one a line.

#include "host/MutableNode.h"
#include "host/OpenMI.h"
#include "host/Properties.h"

#include "own_time.h"

#include <chrono>
#include <cstdlib>
#include <dlfcn.h>
#include <unistd.h>
#include <vector>

namespace
{

FILE* list = nullptr;

IC::MutableNode const* newestEntry(IC::ManagementInterface& interface)
{
    std::vector<IC::Node*> nodes;
    interface.getMap(nodes);
    for (IC::Node* node : nodes)
        if (auto const* entry = dynamic_cast<IC::MutableNode*>(node);
            entry && entry->getNodeType() == IC::nodeType::logEntry)
            return entry;
    return nullptr;
}

/** Microseconds for each of so many reads. */
double readTime(IC::MutableNode const& entry, int reads)
{
    auto const before = std::chrono::steady_clock::now();
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    for (int i = 0; i < reads; ++i)
        entry.getProperty(IC::property::message, value);
    std::chrono::duration<double, std::micro> const time =
        std::chrono::steady_clock::now() - before;
    return time.count() / reads;
}

} // namespace

extern "C" FILE* popen(char const* command, char const* mode)
{
    static auto const real = reinterpret_cast<decltype(&popen)>(dlsym(RTLD_NEXT, "popen"));
    if (list)
        std::fprintf(list, "%s\n", command);
    return real(command, mode);
}

int main(int argc, char* argv[])
{
    if (argc < 2)
        return 1;
    int const reads = argc > 2 ? std::atoi(argv[2]) : 0;
    if (argc > 3)
        list = std::fopen(argv[3], "w");
    void* const library = dlopen(argv[1], RTLD_NOW);
    void* const entryPoint = library ? dlsym(library, "OpenMI") : nullptr;
    if (!entryPoint)
        return 1;
    IC::ManagementInterface* interface = nullptr;
    IC::Error* error = nullptr;
    reinterpret_cast<decltype(&OpenMI)>(entryPoint)(&interface, &error);
    interface->initialize(1, IC::Number(0U), IC::Number(0U));
    printOwnTime();
    IC::MutableNode const* const entry = reads > 0 ? newestEntry(*interface) : nullptr;
    if (entry) {
        double const first = readTime(*entry, 1);
        std::printf("%.1f %.1f\n", first, readTime(*entry, reads));
    }
    std::fflush(nullptr);
    _exit(0); // what follows a start is not measured
}
