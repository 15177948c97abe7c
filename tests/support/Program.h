#ifndef TESTS_SUPPORT_PROGRAM_H
#define TESTS_SUPPORT_PROGRAM_H

#include "tests/support/Lines.h"

#include <iosfwd>
#include <string>
#include <vector>

/** How a program ended and what it wrote. */
struct Outcome {
    int code; // the exit code, or 128 and the number of the signal that ended it
    std::string out;
    std::string err;
};

bool operator==(Outcome const& one, Outcome const& other);
std::ostream& operator<<(std::ostream& out, Outcome const& outcome);

/** The outcome of a program that succeeds and prints only this. */
Outcome printed(std::string const& out);

/** The outcome of mihost if it fails and prints only this message. */
Outcome failed(int code, std::string const& message);

/**
 * Runs a program to its end. A message of mihost that is not in the usual form fails the test.
 *
 * @param arguments  the program's path first
 * @param input      what it reads from standard input, which is not a terminal
 */
Outcome runToEnd(std::vector<std::string> const& arguments, std::string const& input = "");

/** Runs mihost with the plug-in of the same build. */
Outcome mihostRun(std::vector<std::string> arguments, std::string const& input = "");

/** Runs a line in bash, with mihost's path in the variable $mihost. */
Outcome bashRun(std::string const& line, std::string const& input = "");

#endif
