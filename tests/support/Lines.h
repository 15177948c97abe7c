#ifndef TESTS_SUPPORT_LINES_H
#define TESTS_SUPPORT_LINES_H

#include <string>
#include <vector>

using Lines = std::vector<std::string>;

/** The text of a file; empty if it cannot be read. */
std::string contentOf(std::string const& path);

/** The lines of a text, without their ends. */
Lines linesOf(std::string const& text);

#endif
