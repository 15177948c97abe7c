#include "mihost/cli/system/TextFile.h"

#include <fstream>
#include <sstream>

namespace mihost
{

std::string contentOf(std::string const& path)
{
    std::ifstream const file(path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

std::vector<std::string> linesOf(std::string const& text)
{
    std::istringstream stream(text);
    std::vector<std::string> lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

} // namespace mihost
