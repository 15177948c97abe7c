#include "mihost/cli/Program.h"

int main(int argc, char** argv)
{
    return mihost::runProgram(argc, argv);
}
