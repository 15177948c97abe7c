#ifndef MIHOST_ACCEL_LINEINDEX_H
#define MIHOST_ACCEL_LINEINDEX_H

#include "mihost/accel/FileStamp.h"
#include "mihost/accel/TextFile.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace miaccel
{

constexpr std::uint64_t kibibyte = 1024;

/** A stretch of a file, in bytes. */
struct Extent {
    std::uint64_t offset;
    std::uint64_t length;
};

/**
 * Where the lines of a file are: for every block of the file, how many line ends stand before it.
 *
 * Finding a line reads the block where it begins and the block where it ends, and nothing else.
 * Blocks double when there are too many, so the memory is bounded.
 */
class LineIndex
{
public:
    struct Limits {
        std::uint64_t block = 16 * kibibyte;
        std::size_t maxBlocks = 16384; // an even number
        /** Up to this size a file that changed is read again as a whole. */
        std::uint64_t cheap = 1024 * kibibyte;
    };

    LineIndex();
    explicit LineIndex(Limits limits);

    /**
     * Makes the index that of the file as it is now.
     *
     * @return false where the file cannot be read to the end that it had at first
     */
    bool update(TextFile const& file);

    /** Line ends in the file; text after the last one is not counted. */
    std::uint64_t lineEnds() const;

    /**
     * Where a line stands, its end included. A line that the file does not have is empty.
     *
     * @param line  1 for the first
     * @return nothing where the file is no longer the one of the index
     */
    std::optional<Extent> find(TextFile const& file, std::uint64_t line) const;

private:
    /** Digests of the first and of the last bytes that are indexed. */
    using Ends = std::array<std::size_t, 2>;

    void clear();
    bool isAppendedTo(TextFile const& file, FileStamp const& now) const;
    std::optional<Ends> ends(TextFile const& file) const;
    bool extend(TextFile const& file, std::uint64_t size);
    void beginBlock();
    std::optional<std::uint64_t> lineEnd(TextFile const& file, std::uint64_t number) const;

    Limits limits_;
    std::optional<FileStamp> stamp_; // of what is indexed; none where that is nothing
    std::uint64_t indexed_ = 0;      // bytes
    std::uint64_t lineEnds_ = 0;
    std::uint64_t block_ = 0;
    std::vector<std::uint64_t> before_; // line ends before each block
    Ends ends_{};
};

} // namespace miaccel

#endif
