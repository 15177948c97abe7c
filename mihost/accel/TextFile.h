#ifndef MIHOST_ACCEL_TEXTFILE_H
#define MIHOST_ACCEL_TEXTFILE_H

#include "mihost/accel/Answer.h"
#include "mihost/accel/FileStamp.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace miaccel
{

/** A regular file, open for reading, on a file system that keeps change times well. */
class TextFile
{
public:
    explicit TextFile(std::string const& path);
    ~TextFile();
    TextFile(TextFile const&) = delete;
    TextFile& operator=(TextFile const&) = delete;

    /** Null where the file is open and as it should be; nothing else may be asked for otherwise. */
    Reason declined() const;

    std::optional<FileStamp> stamp() const;

    /** Fills the whole buffer; false where the file ends before that, or cannot be read. */
    bool read(char* buffer, std::size_t length, std::uint64_t offset) const;

private:
    int descriptor_;
    Reason declined_;
};

} // namespace miaccel

#endif
