#ifndef MIHOST_ACCEL_STREAM_H
#define MIHOST_ACCEL_STREAM_H

#include <cstdio>
#include <optional>
#include <string>

namespace miaccel
{

/**
 * A stream with what the command prints, or null if that is left to the real popen. Counts which of
 * the two it was. Throws nothing.
 */
FILE* openAnswer(char const* command, char const* mode) noexcept;

/** A stream without a descriptor that reads the text, which it owns; null if none can be made. */
FILE* openStream(std::string text);

/** The popen and pclose that this library interposes. */
FILE* realPopen(char const* command, char const* mode);
int realPclose(FILE* stream);

/** What a command prints; nothing if it cannot be run or fails. */
std::optional<std::string> realOutput(char const* command);

} // namespace miaccel

#endif
