#ifndef UTIL_FILE_H
#define UTIL_FILE_H

#include "util/internal.h"

#include <cstddef>
#include <cstdio>
#include <string_view>
#include <vector>

/** Files as C streams. Not part of the plug-in's interface. */
namespace NQ
{

namespace MI_INTERNAL files
{

/** A stream opened with fopen, closed by the destructor. */
class File
{
public:
    File(char const* path, char const* mode);
    ~File();
    File(File const&) = delete;
    File& operator=(File const&) = delete;

    /** Null if the file could not be opened. */
    FILE* stream() const;

private:
    FILE* const stream_;
};

/** Whether the file can be opened for reading. */
bool canOpen(char const* path);

/**
 * Reads a stream to its end and keeps what the buffer holds, with a NUL after it.
 *
 * @param size  of the buffer, at least 1
 * @return whether there was anything to read
 */
bool readToEnd(FILE* stream, char* buffer, std::size_t size);

/** Reads whole files, each into the memory of the one before. */
class WholeText
{
public:
    /** @return what could be read of the file, valid until the next read */
    std::string_view read(char const* path);

private:
    std::vector<char> buffer_;
};

} // namespace files

} // namespace NQ

#endif
