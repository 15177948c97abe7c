#include "tests/support/Lines.h"

#include <fstream>
#include <sstream>

std::string contentOf(std::string const& path)
{
    std::ifstream const file(path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

Lines linesOf(std::string const& text)
{
    std::istringstream stream(text);
    Lines lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}
