#ifndef MIHOST_CLI_OUTPUT_OUTPUT_H
#define MIHOST_CLI_OUTPUT_OUTPUT_H

#include "mihost/cli/input/Options.h"
#include "mihost/cli/output/Layout.h"

#include <cstdio>
#include <exception>
#include <functional>
#include <optional>
#include <string_view>

namespace mihost
{

/** The reader closed the output: nothing is left to do, and this is not an error. */
class OutputClosed : public std::exception
{
};

/** The destination of a command's results, in the user's format. */
class Output
{
public:
    explicit Output(std::FILE* stream);

    /** Takes format, colours, width and paging from the options. */
    void setOptions(Options const& options)
    {
        options_ = options;
    }

    /** @throws OutputClosed, or Failure if the text cannot be written */
    void write(std::string_view text);

    /** Writes printable, perhaps styled text and a line end. */
    void line(std::string_view text);
    void lines(std::vector<std::string> const& texts);

    /** Whether the user's format is one for documents, or one for rows. */
    bool takesDocuments() const
    {
        return isDocument(options_.format);
    }
    bool takesRows() const
    {
        return isRows(options_.format);
    }

    /** Writes the document in the user's format, which is one for documents. */
    void json(Json const& document);

    /** Writes the table in the user's format, whichever it is. */
    void table(Table const& table);

    /** Writes the table's row in the user's format: an object, or lines of heading and value. */
    void record(Table const& table);

    /**
     * Runs the step, which writes. At a terminal that does not hold all of it, a pager shows it.
     *
     * @throws as write
     */
    void paged(std::function<void()> const& step);

    /** @throws as write */
    void flush();

    /** @return how many bytes were written so far */
    std::size_t size() const
    {
        return size_;
    }

    int descriptor() const
    {
        return fileno(stream_);
    }

    /** The width of a line: the terminal's columns, if it is one. */
    Room room() const;

private:
    [[noreturn]] static void fail();
    bool mayPage() const;
    std::string shown(std::string_view text) const;

    std::FILE* stream_;
    Options options_;
    std::size_t size_ = 0;
    std::optional<std::string> held_; // buffered text, until it is known whether to page
};

} // namespace mihost

#endif
