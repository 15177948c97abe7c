#ifndef MIHOST_ACCEL_LINEINDEX_H
#define MIHOST_ACCEL_LINEINDEX_H

#include <cstdint>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <vector>

namespace miaccel
{

/** Fills the whole buffer; false if the file ends before that or cannot be read. */
bool readAt(int file, char* buffer, std::uint64_t length, std::uint64_t offset);

/**
 * The positions of a file's lines: the number of line ends before each block.
 *
 * Finding a line reads one block of the file. Files are given by their descriptors.
 */
class LineIndex
{
public:
    static constexpr std::uint64_t block = 65'536;
    /** The bytes at both ends of the indexed part that are compared each time. */
    static constexpr std::uint64_t edge = 16'384;

    /**
     * Updates the index: reads what was appended, or the whole file if it is another one or changed
     * in another way.
     *
     * @param now  the file's state, which was taken before
     * @return false if the file cannot be read to its end at that time
     */
    bool update(int file, struct stat const& now);

    /** Line ends in the file; text after the last one does not count. */
    std::uint64_t lineEnds() const
    {
        return lineEnds_;
    }
    bool hasNul() const
    {
        return hasNul_;
    }

    /**
     * The offset at which a line begins: the end of the file past the last line.
     *
     * @param line  1 for the first
     * @return nothing if the file is not the indexed one
     */
    std::optional<std::uint64_t> find(int file, std::uint64_t line) const;

private:
    bool extend(int file, std::uint64_t size);
    std::optional<std::string> edges(int file) const;

    struct stat state_ {
    };
    std::uint64_t indexed_ = 0; // bytes
    std::uint64_t lineEnds_ = 0;
    bool hasNul_ = false;
    std::vector<std::uint64_t> before_; // line ends before each block
    std::optional<std::string> edges_;  // none: nothing is indexed
};

} // namespace miaccel

#endif
