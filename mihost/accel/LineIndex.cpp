#include "mihost/accel/LineIndex.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <unistd.h>

namespace miaccel
{

namespace
{

using Buffer = std::array<char, LineIndex::block>;

/** Counts in blocks so small that a byte can count them: compilers vectorise such a loop. */
std::uint64_t countLineEnds(char const* text, std::uint64_t length)
{
    constexpr std::uint64_t stretch = 255;
    std::uint64_t count = 0;
    for (char const* const end = text + length; text != end;) {
        char const* const stop = text + std::min<std::uint64_t>(stretch, end - text);
        std::uint8_t found = 0;
        for (; text != stop; ++text)
            found = static_cast<std::uint8_t>(found + (*text == '\n'));
        count += found;
    }
    return count;
}

bool isSameFile(struct stat const& one, struct stat const& other)
{
    return one.st_dev == other.st_dev && one.st_ino == other.st_ino;
}

bool isUnchanged(struct stat const& before, struct stat const& now)
{
    return before.st_size == now.st_size && before.st_ctim.tv_sec == now.st_ctim.tv_sec &&
           before.st_ctim.tv_nsec == now.st_ctim.tv_nsec;
}

} // namespace

bool readAt(int file, char* buffer, std::uint64_t length, std::uint64_t offset)
{
    return pread(file, buffer, length, static_cast<off_t>(offset)) == static_cast<ssize_t>(length);
}

bool LineIndex::update(int file, struct stat const& now)
{
    auto const size = static_cast<std::uint64_t>(now.st_size);
    bool const isContinued =
        edges_ && isSameFile(state_, now) && size >= indexed_ && edges(file) == edges_;
    if (isContinued && isUnchanged(state_, now))
        return true;
    if (!isContinued || size == indexed_)
        *this = {};
    state_ = now;
    edges_ = extend(file, size) ? edges(file) : std::nullopt;
    return edges_.has_value();
}

bool LineIndex::extend(int file, std::uint64_t size)
{
    Buffer buffer;
    while (indexed_ < size) {
        std::uint64_t const inBlock = indexed_ % block;
        if (inBlock == 0)
            before_.push_back(lineEnds_);
        std::uint64_t const want = std::min(block - inBlock, size - indexed_);
        if (!readAt(file, buffer.data(), want, indexed_))
            return false;
        lineEnds_ += countLineEnds(buffer.data(), want);
        hasNul_ = hasNul_ || std::memchr(buffer.data(), '\0', want);
        indexed_ += want;
    }
    return true;
}

std::optional<std::string> LineIndex::edges(int file) const
{
    std::uint64_t const length = std::min(edge, indexed_);
    std::string text(2 * length, '\0');
    if (!readAt(file, text.data(), length, 0) ||
        !readAt(file, text.data() + length, length, indexed_ - length))
        return std::nullopt;
    return text;
}

std::optional<std::uint64_t> LineIndex::find(int file, std::uint64_t line) const
{
    if (line == 1)
        return 0;
    if (line > lineEnds_ + 1)
        return indexed_;
    std::uint64_t const number = line - 1; // of the line end before it
    auto const next = std::lower_bound(before_.begin(), before_.end(), number);
    auto const index = static_cast<std::uint64_t>(next - before_.begin()) - 1;
    std::uint64_t const offset = index * block;
    std::uint64_t const length = std::min(block, indexed_ - offset);
    Buffer buffer;
    if (!readAt(file, buffer.data(), length, offset))
        return std::nullopt;
    char const* const end = buffer.data() + length;
    char const* at = buffer.data();
    for (std::uint64_t left = number - before_[index]; left > 0; --left) {
        void const* const found = std::memchr(at, '\n', static_cast<std::size_t>(end - at));
        if (!found)
            return std::nullopt;
        at = static_cast<char const*>(found) + 1;
    }
    return offset + static_cast<std::uint64_t>(at - buffer.data());
}

} // namespace miaccel
