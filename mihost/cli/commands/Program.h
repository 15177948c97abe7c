#ifndef MIHOST_CLI_COMMANDS_PROGRAM_H
#define MIHOST_CLI_COMMANDS_PROGRAM_H

namespace mihost
{

/** The whole program, from its arguments to its exit code. */
int runProgram(int argc, char** argv);

} // namespace mihost

#endif
