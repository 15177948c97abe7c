#ifndef MIHOST_SANDBOX_DESCRIPTOR_H
#define MIHOST_SANDBOX_DESCRIPTOR_H

#include <unistd.h>
#include <utility>

namespace mihost
{

/** Owns a file descriptor; holds none when it is negative. */
class Descriptor
{
public:
    explicit Descriptor(int fd = -1) : fd_(fd) {}
    ~Descriptor()
    {
        reset();
    }
    Descriptor(Descriptor&& other) noexcept : fd_(std::exchange(other.fd_, -1)) {}
    Descriptor& operator=(Descriptor&& other) noexcept
    {
        std::swap(fd_, other.fd_);
        return *this;
    }
    Descriptor(Descriptor const&) = delete;
    Descriptor& operator=(Descriptor const&) = delete;

    int get() const
    {
        return fd_;
    }
    explicit operator bool() const
    {
        return fd_ >= 0;
    }
    /** Gives the descriptor away. */
    int release()
    {
        return std::exchange(fd_, -1);
    }
    void reset()
    {
        if (fd_ >= 0)
            close(release());
    }

private:
    int fd_;
};

} // namespace mihost

#endif
