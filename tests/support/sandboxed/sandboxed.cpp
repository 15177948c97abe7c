// sandboxed PROGRAM [ARGUMENT...]: runs a program in a copy-on-write copy of this machine.

#include "mihost/sandbox/Sandbox.h"

#include <cstdio>
#include <cstdlib>
#include <unistd.h>

int main(int argc, char* argv[])
{
    if (argc < 2) {
        std::fputs("sandboxed PROGRAM [ARGUMENT...]\n", stderr);
        return EXIT_FAILURE;
    }
    if (auto const reason = mihost::enterSandbox()) {
        std::fprintf(stderr, "no sandbox: %s\n", reason->c_str());
        return EXIT_FAILURE;
    }
    execvp(argv[1], argv + 1);
    std::perror(argv[1]);
    return EXIT_FAILURE;
}
