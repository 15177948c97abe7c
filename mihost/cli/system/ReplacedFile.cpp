#include "mihost/cli/system/ReplacedFile.h"

#include "mihost/cli/system/Failure.h"
#include "mihost/sandbox/Descriptor.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace mihost
{

namespace
{

bool writeAll(int file, std::string_view text)
{
    while (!text.empty()) {
        ssize_t const written = write(file, text.data(), text.size());
        if (written < 0 && errno != EINTR)
            return false;
        if (written > 0)
            text.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

} // namespace

void replaceFile(std::string const& path, std::string const& text, char const* doing)
{
    auto const failure = [&](int problem) {
        return Failure(BadUsage, fmt::format("{} '{}': {}", doing, path, std::strerror(problem)));
    };
    constexpr mode_t everybodyReads = S_IRUSR | S_IWUSR | S_IRGRP | S_IROTH;
    std::string draft = path + ".XXXXXX";
    Descriptor const file(mkostemp(draft.data(), O_CLOEXEC));
    if (!file)
        throw failure(errno);
    // Synced before it is renamed, or a crash could leave an empty file.
    bool const done = writeAll(file.get(), text) && fchmod(file.get(), everybodyReads) == 0 &&
                      fsync(file.get()) == 0 && rename(draft.c_str(), path.c_str()) == 0;
    if (!done) {
        int const problem = errno;
        unlink(draft.c_str());
        throw failure(problem);
    }
}

} // namespace mihost
