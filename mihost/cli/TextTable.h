#ifndef MIHOST_CLI_TEXTTABLE_H
#define MIHOST_CLI_TEXTTABLE_H

#include <string>
#include <vector>

namespace mihost
{

/** Columns that a text takes on a terminal. The text is printable UTF-8. */
std::size_t displayWidth(std::string const& text);

/** The text, cut to so many columns and marked as cut where it is wider. */
std::string fitted(std::string const& text, std::size_t columns);

/** Rows of cells under a heading, in columns as wide as they need to be. */
class TextTable
{
public:
    explicit TextTable(std::vector<std::string> heading);

    /** @param cells  printable text, one for each column */
    void add(std::vector<std::string> cells);

    /**
     * The lines, without line ends.
     *
     * @param columns  what the widest cells are cut to fit into; 0 for no limit
     */
    std::vector<std::string> lines(std::size_t columns) const;

private:
    std::vector<std::vector<std::string>> rows_;
};

} // namespace mihost

#endif
