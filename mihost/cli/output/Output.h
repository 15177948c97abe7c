#ifndef MIHOST_CLI_OUTPUT_OUTPUT_H
#define MIHOST_CLI_OUTPUT_OUTPUT_H

#include "mihost/cli/output/Json.h"
#include "mihost/cli/output/TextTable.h"

#include <cstdio>
#include <exception>
#include <string_view>

namespace mihost
{

/** The reader of the output has gone: nothing is left to do, and nothing is wrong. */
class OutputClosed : public std::exception
{
};

/** Where a command's results go. */
class Output
{
public:
    explicit Output(std::FILE* stream);

    /** @throws OutputClosed, or Failure where the text cannot be written */
    void write(std::string_view text);

    /** Writes the text and a line end. */
    void line(std::string_view text);

    /** Writes the document on one line. */
    void json(Json const& document);

    /** @throws as write */
    void flush();

    /** The text in bold or faint where that can be shown. */
    std::string bold(std::string const& text) const;
    std::string faint(std::string const& text) const;

    /** How much was written so far. */
    std::size_t size() const
    {
        return size_;
    }

    int descriptor() const
    {
        return fileno(stream_);
    }

    /** What a line may take: the terminal's columns where it goes to one. */
    Room room() const;

private:
    [[noreturn]] static void fail();
    std::string styled(char const* start, std::string const& text) const;

    std::FILE* stream_;
    std::size_t size_ = 0;
};

} // namespace mihost

#endif
