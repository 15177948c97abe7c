#include "mihost/accel/LineIndex.h"

#include <algorithm>
#include <cstring>
#include <functional>
#include <string_view>

namespace miaccel
{

namespace
{

constexpr std::uint64_t chunk = 16 * kibibyte; // bytes read at a time

/** Counts in bytes, as many as cannot overflow one, which compilers turn into wide instructions. */
std::uint64_t countLineEnds(char const* text, std::uint64_t length)
{
    std::uint64_t count = 0;
    while (length > 0) {
        std::uint64_t const stretch = std::min<std::uint64_t>(length, 255);
        std::uint8_t found = 0;
        for (std::uint64_t i = 0; i < stretch; ++i)
            found = static_cast<std::uint8_t>(found + (text[i] == '\n'));
        count += found;
        text += stretch;
        length -= stretch;
    }
    return count;
}

} // namespace

LineIndex::LineIndex() : LineIndex(Limits{}) {}

LineIndex::LineIndex(Limits limits) : limits_(limits)
{
    clear();
}

void LineIndex::clear()
{
    stamp_.reset();
    indexed_ = 0;
    lineEnds_ = 0;
    block_ = limits_.block;
    before_.clear();
}

bool LineIndex::update(TextFile const& file)
{
    std::optional<FileStamp> const now = file.stamp();
    if (!now)
        return false;
    if (stamp_ && now->isUnchangedSince(*stamp_))
        return true;
    if (!isAppendedTo(file, *now))
        clear();
    stamp_.reset();
    if (!extend(file, now->size()))
        return false;
    std::optional<Ends> const seen = ends(file);
    if (!seen)
        return false;
    ends_ = *seen;
    stamp_ = now;
    return true;
}

bool LineIndex::isAppendedTo(TextFile const& file, FileStamp const& now) const
{
    return stamp_ && indexed_ > limits_.cheap && now.isSameFile(*stamp_) && now.size() > indexed_ &&
           ends(file) == ends_;
}

std::optional<LineIndex::Ends> LineIndex::ends(TextFile const& file) const
{
    constexpr std::uint64_t most = 4096;
    std::uint64_t const length = std::min(most, indexed_);
    std::array<char, most> buffer;
    Ends digests{};
    std::array<std::uint64_t, 2> const offsets{0, indexed_ - length};
    for (std::size_t end = 0; end < digests.size(); ++end) {
        if (!file.read(buffer.data(), length, offsets[end]))
            return std::nullopt;
        digests[end] = std::hash<std::string_view>()({buffer.data(), length});
    }
    return digests;
}

bool LineIndex::extend(TextFile const& file, std::uint64_t size)
{
    std::array<char, chunk> buffer;
    while (indexed_ < size) {
        if (indexed_ == before_.size() * block_)
            beginBlock();
        std::uint64_t const want =
            std::min({chunk, before_.size() * block_ - indexed_, size - indexed_});
        if (!file.read(buffer.data(), want, indexed_))
            return false;
        lineEnds_ += countLineEnds(buffer.data(), want);
        indexed_ += want;
    }
    return true;
}

void LineIndex::beginBlock()
{
    if (before_.size() == limits_.maxBlocks) {
        for (std::size_t kept = 0; kept < before_.size() / 2; ++kept)
            before_[kept] = before_[2 * kept];
        before_.resize(before_.size() / 2);
        block_ *= 2;
    }
    before_.push_back(lineEnds_);
}

std::uint64_t LineIndex::lineEnds() const
{
    return lineEnds_;
}

std::optional<Extent> LineIndex::find(TextFile const& file, std::uint64_t line) const
{
    if (line > lineEnds_ + 1)
        return Extent{indexed_, 0};
    std::uint64_t begin = 0;
    if (line > 1) {
        std::optional<std::uint64_t> const previous = lineEnd(file, line - 1);
        if (!previous)
            return std::nullopt;
        begin = *previous + 1;
    }
    std::uint64_t end = indexed_;
    if (line <= lineEnds_) {
        std::optional<std::uint64_t> const own = lineEnd(file, line);
        if (!own || *own < begin)
            return std::nullopt;
        end = *own + 1;
    }
    return Extent{begin, end - begin};
}

/** The offset of a line end, 1 for the first; it must be one of those counted. */
std::optional<std::uint64_t> LineIndex::lineEnd(TextFile const& file, std::uint64_t number) const
{
    auto const next = std::lower_bound(before_.begin(), before_.end(), number);
    auto const block = static_cast<std::uint64_t>(next - before_.begin()) - 1;
    std::uint64_t left = number - before_[block];
    std::uint64_t at = block * block_;
    std::uint64_t const stop = std::min(at + block_, indexed_);
    std::array<char, chunk> buffer;
    while (at < stop) {
        std::uint64_t const want = std::min(chunk, stop - at);
        if (!file.read(buffer.data(), want, at))
            return std::nullopt;
        char const* const end = buffer.data() + want;
        char const* from = buffer.data();
        while (void const* found = std::memchr(from, '\n', static_cast<std::size_t>(end - from))) {
            char const* const lineFeed = static_cast<char const*>(found);
            if (--left == 0)
                return at + static_cast<std::uint64_t>(lineFeed - buffer.data());
            from = lineFeed + 1;
        }
        at += want;
    }
    return std::nullopt;
}

} // namespace miaccel
