#ifndef MIHOST_CLI_OUTPUT_COLUMNPRINTER_H
#define MIHOST_CLI_OUTPUT_COLUMNPRINTER_H

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

struct libscols_table;

namespace mihost
{

constexpr char columnGap[] = "  ";
constexpr std::size_t gapWidth = sizeof columnGap - 1;

/** Prints texts in columns, by libsmartcols. A cell may have several lines; none is wrapped. */
class ColumnPrinter
{
public:
    explicit ColumnPrinter(bool hasHeadings);

    void addColumn(std::string const& heading, bool isRight = false);
    void addRow(std::vector<std::string> const& cells);

    std::vector<std::string> lines() const;

private:
    struct Unref {
        void operator()(libscols_table* table) const;
    };

    std::unique_ptr<libscols_table, Unref> table_;
    bool hasHeadings_;
};

/** The lines of a cell. */
std::string joined(std::vector<std::string> const& lines);

} // namespace mihost

#endif
