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

} // namespace NQ::FILES
