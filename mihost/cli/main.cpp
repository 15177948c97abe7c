#include "mihost/cli/Failure.h"
#include "mihost/cli/Program.h"
#include "mihost/cli/StandardFiles.h"

int main(int argc, char** argv)
{
    if (!mihost::fillMissingStandardFiles())
        return mihost::BadUsage;
    return mihost::runProgram(argc, argv);
}
