#include "util/file.h"

namespace NQ::FILES
{

File::File(char const* path, char const* mode) : stream_(std::fopen(path, mode)) {}

File::~File()
{
    if (stream_)
        std::fclose(stream_);
}

FILE* File::stream() const
{
    return stream_;
}

bool canOpen(char const* path)
{
    return File(path, "r").stream() != nullptr;
}

bool readToEnd(FILE* stream, char* buffer, std::size_t size)
{
    std::size_t kept = 0;
    bool any = false;
    for (int c = std::getc(stream); c != EOF; c = std::getc(stream)) {
        any = true;
        if (kept < size - 1)
            buffer[kept++] = static_cast<char>(c);
    }
    buffer[kept] = '\0';
    return any;
}

} // namespace NQ::FILES
