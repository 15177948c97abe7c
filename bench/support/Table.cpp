#include "bench/support/Table.h"

#include <algorithm>
#include <cstdio>

Table::Table(Row head)
{
    rows_.push_back(std::move(head));
}

void Table::add(Row row)
{
    row.resize(rows_.front().size());
    rows_.push_back(std::move(row));
}

void Table::print() const
{
    std::vector<std::size_t> widths(rows_.front().size(), 4);
    for (Row const& row : rows_)
        for (std::size_t column = 0; column < row.size(); ++column)
            widths[column] = std::max(widths[column], row[column].size());
    for (Row const& row : rows_) {
        for (std::size_t column = 0; column < row.size(); ++column)
            std::printf(column == 0 ? "| %-*s " : "| %*s ", static_cast<int>(widths[column]),
                        row[column].c_str());
        std::puts("|");
        if (&row != &rows_.front())
            continue;
        for (std::size_t column = 0; column < row.size(); ++column)
            std::printf("|%s%s", std::string(widths[column] + 1, '-').c_str(),
                        column == 0 ? "-" : ":");
        std::puts("|");
    }
    std::puts("");
    std::fflush(stdout);
}

void say(std::string const& line)
{
    std::printf("%s\n\n", line.c_str());
    std::fflush(stdout);
}
