#ifndef TESTS_SUPPORT_LINES_H
#define TESTS_SUPPORT_LINES_H

#include <string>
#include <vector>

/** The text of a file; empty where it cannot be read. */
std::string contentOf(std::string const& path);

/** The lines of a text, without their ends. */
std::vector<std::string> linesOf(std::string const& text);

#endif
