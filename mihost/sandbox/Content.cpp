#include "mihost/sandbox/Content.h"

#include "mihost/sandbox/SystemCall.h"

namespace mihost
{

void writeAll(Descriptor const& to, char const* text, std::size_t length, std::string const& path)
{
    while (length > 0) {
        ssize_t const written = write(to.get(), text, length);
        if (written < 0 && errno == EINTR)
            continue;
        check(written, "cannot write " + path);
        text += written;
        length -= static_cast<std::size_t>(written);
    }
}

void copyContent(Descriptor const& from, Descriptor const& to, std::string const& path)
{
    char block[65536];
    for (;;) {
        ssize_t const count = read(from.get(), block, sizeof block);
        if (count < 0 && errno == EINTR)
            continue;
        if (check(count, "cannot read " + path) == 0)
            return;
        writeAll(to, block, static_cast<std::size_t>(count), path);
    }
}

} // namespace mihost
