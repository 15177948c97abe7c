// fill_page TEMPLATE: prints a manual page, with lists from the catalogue where the template has
// @PROPERTIES@ and @METHODS@ on lines of their own.

#include "mihost/cli/output/CatalogueText.h"

#include <cctype>
#include <cstdlib>
#include <fmt/ostream.h>
#include <fstream>
#include <iostream>
#include <map>
#include <sstream>
#include <utility>

namespace
{

using namespace mihost;

/** A hyphen is one to be typed; quotes and dots at the start of a line are not macros. */
std::string escaped(std::string const& text)
{
    std::string result;
    for (char const c : text) {
        if (c == '-' || c == '\\')
            result += c == '-' ? "\\-" : "\\e";
        else
            result += c;
    }
    if (!result.empty() && (result[0] == '.' || result[0] == '\''))
        result.insert(0, "\\&");
    return result;
}

/** Lines that are short enough for the checkers of manual pages. */
std::string lines(std::string const& text)
{
    constexpr std::size_t longest = 72; // and some escapes
    std::istringstream words(text);
    std::string all;
    std::string line;
    for (std::string word; words >> word;) {
        if (!line.empty() && line.size() + word.size() >= longest)
            all += escaped(std::exchange(line, "")) + '\n';
        line += line.empty() ? word : ' ' + word;
    }
    return all + escaped(line);
}

std::string sentence(std::string text)
{
    text[0] = static_cast<char>(std::toupper(static_cast<unsigned char>(text[0])));
    return lines(text + '.');
}

/** Such as "number, KiB, live". */
std::string natureOf(Property const& property)
{
    std::string const traits = traitsText(property);
    return typeText(property) + (traits.empty() ? "" : ", " + traits);
}

void writeProperties(std::ostream& out)
{
    for (NodeKind const& kind : nodeKinds()) {
        if (kind.properties.empty())
            continue;
        fmt::print(out, ".Ss {} (type {})\n{}\n.Bl -tag -width Ds\n", escaped(kind.name), kind.type,
                   sentence(kind.meaning));
        for (Property const& property : kind.properties)
            fmt::print(out, ".It Sy {} {}\n.Pq {}\n{}\n", property.id, escaped(property.name),
                       escaped(natureOf(property)), lines(property.meaning));
        fmt::print(out, ".El\n");
    }
}

void writeMethods(std::ostream& out)
{
    fmt::print(out, ".Bl -tag -width Ds\n");
    for (Method const& method : methods()) {
        fmt::print(out, ".It Sy {}\n{}\n", method.name, sentence(method.meaning));
        if (method.parameters.empty())
            continue;
        fmt::print(out, ".Bl -tag -width Ds -compact\n");
        for (Parameter const& parameter : method.parameters)
            fmt::print(out, ".It {} {}\n{}{}\n", parameter.name, parameter.type,
                       parameter.required ? "" : ".Pq optional\n", lines(parameter.meaning));
        fmt::print(out, ".El\n");
    }
    fmt::print(out, ".El\n");
}

} // namespace

int main(int argc, char* argv[])
{
    std::map<std::string, void (*)(std::ostream&)> const lists = {{"@PROPERTIES@", writeProperties},
                                                                  {"@METHODS@", writeMethods}};
    std::ifstream page(argc > 1 ? argv[1] : "");
    if (!page) {
        std::cerr << "usage: fill_page TEMPLATE\n";
        return EXIT_FAILURE;
    }
    for (std::string line; std::getline(page, line);) {
        auto const list = lists.find(line);
        if (list == lists.end())
            std::cout << line << '\n';
        else
            list->second(std::cout);
    }
    return std::cout.flush() ? EXIT_SUCCESS : EXIT_FAILURE;
}
