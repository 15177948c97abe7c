#ifndef MIHOST_SANDBOX_OWNEDSTREAM_H
#define MIHOST_SANDBOX_OWNEDSTREAM_H

#include <cstdio>
#include <memory>

namespace mihost
{

struct CloseStream {
    void operator()(std::FILE* stream) const
    {
        std::fclose(stream);
    }
};

/** Owns a stream. */
using Stream = std::unique_ptr<std::FILE, CloseStream>;

} // namespace mihost

#endif
