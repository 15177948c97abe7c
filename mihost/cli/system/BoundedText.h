#ifndef MIHOST_CLI_SYSTEM_BOUNDEDTEXT_H
#define MIHOST_CLI_SYSTEM_BOUNDEDTEXT_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace mihost
{

/** The beginning of a text of any length. */
class BoundedText
{
public:
    static constexpr std::size_t limit = 1'048'576; // bytes

    void append(std::string_view part);

    /** The kept text, and on a last line "... (N more bytes)" if there was more. */
    std::string text() const;

private:
    std::string kept_;
    std::uint64_t dropped_ = 0;
};

} // namespace mihost

#endif
