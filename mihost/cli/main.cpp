#include "mihost/cli/commands/Program.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/StandardFiles.h"

#include <cstdio>

int main(int argc, char** argv)
{
    if (!mihost::fillMissingStandardFiles()) {
        std::perror("mihost: cannot open /dev/null");
        return mihost::BadUsage;
    }
    return mihost::runProgram(argc, argv);
}
