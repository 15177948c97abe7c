#include "mihost/accel/Stream.h"

#include <array>
#include <dlfcn.h>
#include <memory>

namespace miaccel
{

namespace
{

struct Source {
    std::string text;
    std::size_t at = 0;
};

ssize_t readSource(void* cookie, char* buffer, std::size_t size)
{
    auto& source = *static_cast<Source*>(cookie);
    std::size_t const length = source.text.copy(buffer, size, source.at);
    source.at += length;
    return static_cast<ssize_t>(length);
}

int closeSource(void* cookie)
{
    std::unique_ptr<Source> const source(static_cast<Source*>(cookie));
    return 0;
}

template <class Function> Function* next(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

FILE* openStream(std::string text)
{
    auto source = std::make_unique<Source>(Source{std::move(text)});
    FILE* const stream =
        fopencookie(source.get(), "r", {readSource, nullptr, nullptr, closeSource});
    if (stream)
        (void)source.release(); // closeSource deletes it
    return stream;
}

FILE* realPopen(char const* command, char const* mode)
{
    static auto* const real = next<FILE*(char const*, char const*)>("popen");
    return real(command, mode);
}

int realPclose(FILE* stream)
{
    static auto* const real = next<int(FILE*)>("pclose");
    return real(stream);
}

std::optional<std::string> realOutput(char const* command)
{
    FILE* const stream = realPopen(command, "re");
    if (!stream)
        return std::nullopt;
    std::string text;
    std::array<char, 512> block{};
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        text.append(block.data(), length);
    return realPclose(stream) == 0 ? std::optional(std::move(text)) : std::nullopt;
}

} // namespace miaccel
