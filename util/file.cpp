#include "util/file.h"

#include <algorithm>

namespace NQ::files
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

std::string_view WholeText::read(char const* path)
{
    File const file(path, "r");
    if (!file.stream())
        return {};
    constexpr std::size_t firstSize = 8192;
    buffer_.resize(std::max(buffer_.size(), firstSize));
    std::setvbuf(file.stream(), nullptr, _IONBF, 0); // straight into the buffer here
    std::size_t length = 0;
    while (true) {
        length += std::fread(buffer_.data() + length, 1, buffer_.size() - length, file.stream());
        if (length < buffer_.size())
            return {buffer_.data(), length};
        buffer_.resize(2 * buffer_.size());
    }
}

} // namespace NQ::files
