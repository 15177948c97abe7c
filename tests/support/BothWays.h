#ifndef TESTS_SUPPORT_BOTHWAYS_H
#define TESTS_SUPPORT_BOTHWAYS_H

#include "mihost/accel/Accelerator.h"
#include "tests/support/Libc.h"

#include <array>
#include <cstdio>
#include <optional>
#include <string>

/** What one command prints, asked in both ways. For the tiers that hold the accelerator's parts. */
namespace bothways
{

inline std::string readAll(FILE* stream)
{
    std::string text;
    std::array<char, 65536> block;
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        text.append(block.data(), length);
    return text;
}

/** By a real shell. What it writes to standard error is added to the text. */
inline std::string real(std::string const& command)
{
    FILE* const stream = libc::realPopen(("{ " + command + "; } 2>&1").c_str(), "r");
    std::string text = readAll(stream);
    libc::realPclose(stream);
    return text;
}

/** By the accelerator; nothing where it leaves the command to the real popen. */
inline std::optional<std::string> answered(std::string const& command)
{
    FILE* const stream = miaccel::openAnswer(command.c_str(), "r");
    if (!stream)
        return std::nullopt;
    std::string text = readAll(stream);
    std::fclose(stream);
    return text;
}

} // namespace bothways

#endif
