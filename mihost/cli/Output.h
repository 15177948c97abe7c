#ifndef MIHOST_CLI_OUTPUT_H
#define MIHOST_CLI_OUTPUT_H

#include "mihost/cli/Json.h"

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

    bool isTerminal() const
    {
        return terminal_;
    }

private:
    [[noreturn]] static void fail();

    std::FILE* stream_;
    bool terminal_;
};

} // namespace mihost

#endif
