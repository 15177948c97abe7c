#ifndef TESTS_SUPPORT_PROGRAM_H
#define TESTS_SUPPORT_PROGRAM_H

#include <string>
#include <vector>

/** How a program ended and what it wrote. */
struct Outcome {
    int code; // the exit code, or 128 and the number of the signal that ended it
    std::string out;
    std::string err;
};

/**
 * Runs a program to its end. A message of mihost that is not in the usual form fails the test.
 *
 * @param arguments  the program's path first
 * @param input      what it reads from standard input, which is not a terminal
 */
Outcome runToEnd(std::vector<std::string> const& arguments, std::string const& input = "");

/** Runs mihost with the plug-in of the same build. */
Outcome mihostRun(std::vector<std::string> arguments, std::string const& input = "");

#endif
