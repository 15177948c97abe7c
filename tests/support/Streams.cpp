#include "tests/support/Streams.h"

FILE* streamOf(std::string const& text)
{
    FILE* const stream = std::tmpfile();
    std::fwrite(text.data(), 1, text.size(), stream);
    std::rewind(stream);
    return stream;
}
