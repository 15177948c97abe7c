#include "mihost/cli/Failure.h"
#include "mihost/cli/Program.h"
#include "mihost/cli/StandardFiles.h"

#include <cstdio>

int main(int argc, char** argv)
{
    if (!mihost::fillMissingStandardFiles()) {
        std::perror("mihost: cannot open /dev/null");
        return mihost::BadUsage;
    }
    return mihost::runProgram(argc, argv);
}
