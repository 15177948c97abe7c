#ifndef MIHOST_CLI_OUTPUT_TEXTTABLE_H
#define MIHOST_CLI_OUTPUT_TEXTTABLE_H

#include <limits>
#include <string>
#include <vector>

namespace mihost
{

/** Columns that a text takes on a terminal. The text is printable UTF-8. */
std::size_t displayWidth(std::string const& text);

/** What a line may take. */
struct Room {
    static constexpr std::size_t unlimited = std::numeric_limits<std::size_t>::max();

    std::size_t columns = unlimited;
    char const* cutSign = "…"; // stands where a text was cut; one column
};

/** The text, cut to the room's columns and marked as cut where it is wider. */
std::string fitted(std::string const& text, Room const& room);

/** Rows of cells under a heading, in columns as wide as they need to be. */
class TextTable
{
public:
    explicit TextTable(std::vector<std::string> heading);

    /** @param cells  printable text, one for each column */
    void add(std::vector<std::string> cells);

    /** The lines, without line ends. The widest cells are cut until they fit. */
    std::vector<std::string> lines(Room const& room) const;

private:
    std::vector<std::vector<std::string>> rows_;
};

} // namespace mihost

#endif
