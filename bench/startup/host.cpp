// startup_host PLUGIN [LIST]: starts the plug-in as a host does, without a log, and prints its own
// processor time. With a file given, notes there every command that the plug-in runs, one a line.

#include "host/OpenMI.h"

#include "own_time.h"

#include <dlfcn.h>
#include <unistd.h>

namespace
{
FILE* list = nullptr;
}

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
    if (argc > 2)
        list = std::fopen(argv[2], "w");
    void* const library = dlopen(argv[1], RTLD_NOW);
    void* const entry = library ? dlsym(library, "OpenMI") : nullptr;
    if (!entry)
        return 1;
    IC::ManagementInterface* interface = nullptr;
    IC::Error* error = nullptr;
    reinterpret_cast<decltype(&OpenMI)>(entry)(&interface, &error);
    interface->initialize(1, IC::Number(0U), IC::Number(0U));
    printOwnTime();
    std::fflush(nullptr);
    _exit(0); // what follows a start is not measured
}
