#ifndef MIHOST_ACCEL_STREAM_H
#define MIHOST_ACCEL_STREAM_H

#include <cstdio>
#include <string>

namespace miaccel
{

/**
 * A stream that reads the text, which it owns; null where none can be made. It behaves as a pipe
 * does, without a descriptor, and is closed with closeStream, or with fclose.
 */
FILE* openStream(std::string text);

/** Closes a stream that openStream made; false, and nothing done, for any other one. */
bool closeStream(FILE* stream);

} // namespace miaccel

#endif
