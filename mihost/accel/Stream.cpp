#include "mihost/accel/Stream.h"

#include <cerrno>
#include <memory>
#include <mutex>
#include <unordered_set>

namespace miaccel
{

namespace
{

/** The streams that are open. Never destroyed: threads may run to the very end of the process. */
class Registry
{
public:
    void add(FILE* stream)
    {
        std::lock_guard const held(lock_);
        streams_.insert(stream);
    }

    /** @return false where it was not there */
    bool remove(FILE* stream)
    {
        std::lock_guard const held(lock_);
        return streams_.erase(stream) != 0;
    }

private:
    std::mutex lock_;
    std::unordered_set<FILE*> streams_;
};

Registry& registry()
{
    static auto& open = *new Registry;
    return open;
}

/** What a stream reads from; its C library calls come one at a time. */
struct Source {
    std::string text;
    std::size_t at = 0;
    FILE* stream = nullptr;
};

ssize_t readSource(void* cookie, char* buffer, std::size_t size)
{
    auto& source = *static_cast<Source*>(cookie);
    std::size_t const length = source.text.copy(buffer, size, source.at);
    source.at += length;
    return static_cast<ssize_t>(length);
}

int seekSource(void*, off64_t*, int)
{
    errno = ESPIPE;
    return -1;
}

struct CloseFile {
    void operator()(FILE* stream) const
    {
        std::fclose(stream);
    }
};

int closeSource(void* cookie)
{
    std::unique_ptr<Source> const source(static_cast<Source*>(cookie));
    registry().remove(source->stream);
    return 0;
}

} // namespace

FILE* openStream(std::string text)
{
    auto source = std::make_unique<Source>(Source{std::move(text)});
    std::unique_ptr<FILE, CloseFile> stream(
        fopencookie(source.get(), "r", {readSource, nullptr, seekSource, closeSource}));
    if (!stream)
        return nullptr;
    source.release()->stream = stream.get(); // the stream's own from now on
    registry().add(stream.get());
    return stream.release();
}

bool closeStream(FILE* stream)
{
    if (!registry().remove(stream))
        return false;
    std::fclose(stream);
    return true;
}

} // namespace miaccel
