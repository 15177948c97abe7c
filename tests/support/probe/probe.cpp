// Runs commands as a host's plug-in does. Prints their output; on standard error, a line with the
// status of each and, if the accelerator is loaded, a line with each of its counts.

#include "mihost/accel/Accel.h"

#include <cstdio>
#include <dlfcn.h>

namespace
{

void run(char const* command)
{
    FILE* const stream = popen(command, "r");
    if (!stream) {
        std::fprintf(stderr, "none\n");
        return;
    }
    for (int character = std::fgetc(stream); character != EOF; character = std::fgetc(stream))
        std::putchar(character);
    std::fprintf(stderr, "status %d\n", pclose(stream));
}

void printCounts()
{
    auto const counts =
        reinterpret_cast<decltype(&miaccel_counts)>(dlsym(RTLD_DEFAULT, "miaccel_counts"));
    if (!counts)
        return;
    miaccel_count rows[16];
    std::size_t const count = counts(rows, 16);
    for (std::size_t row = 0; row < count; ++row)
        std::fprintf(stderr, "%s %lu %lu\n", rows[row].command, rows[row].answered, rows[row].ran);
}

} // namespace

int main(int argc, char** argv)
{
    for (int i = 1; i < argc; ++i)
        run(argv[i]);
    printCounts();
}
