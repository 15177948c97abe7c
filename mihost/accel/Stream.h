#ifndef MIHOST_ACCEL_STREAM_H
#define MIHOST_ACCEL_STREAM_H

#include <cstdio>
#include <optional>
#include <string>

namespace miaccel
{

/**
 * @return a stream with what the command prints, or null if the real popen must run it. Counts
 *         which of the two it was. Throws nothing.
 */
FILE* openAnswer(char const* command, char const* mode) noexcept;

/** @return a stream without a descriptor that reads the text; null if none can be made */
FILE* openStream(std::string text);

/** The popen and pclose that this library interposes. */
FILE* realPopen(char const* command, char const* mode);
int realPclose(FILE* stream);

/** What a command prints; nothing if it cannot be run or fails. */
std::optional<std::string> realOutput(char const* command);

} // namespace miaccel

#endif
