#ifndef BENCH_SUPPORT_TABLE_H
#define BENCH_SUPPORT_TABLE_H

#include <string>
#include <vector>

/** A table in Markdown, its columns aligned for people who read it on a terminal. */
class Table
{
public:
    using Row = std::vector<std::string>;

    /** @param head  the columns' names; all but the first hold numbers */
    explicit Table(Row head);

    void add(Row row);

    /** Writes it to standard output, followed by an empty line. */
    void print() const;

private:
    std::vector<Row> rows_;
};

/** Writes a line to standard output, followed by an empty one. */
void say(std::string const& line);

#endif
