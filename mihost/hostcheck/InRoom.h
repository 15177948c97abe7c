#ifndef MIHOST_HOSTCHECK_INROOM_H
#define MIHOST_HOSTCHECK_INROOM_H

#include <algorithm>
#include <cstddef>
#include <new>
#include <utility>

namespace hostcheck
{

/**
 * An object with room after it, which stays untouched unless the host's own class is larger than
 * the one declared in host/.
 */
template <class Object> class InRoom
{
public:
    template <class... Arguments> explicit InRoom(Arguments&&... arguments)
    {
        std::fill(std::begin(bytes_), std::end(bytes_), fill_);
        object_ = new (bytes_) Object(std::forward<Arguments>(arguments)...);
    }

    ~InRoom()
    {
        object_->~Object();
    }

    InRoom(InRoom const&) = delete;
    InRoom& operator=(InRoom const&) = delete;

    Object& operator*()
    {
        return *object_;
    }

    Object* operator->()
    {
        return object_;
    }

    bool overrun() const
    {
        return std::any_of(bytes_ + sizeof(Object), std::end(bytes_),
                           [this](unsigned char byte) { return byte != fill_; });
    }

private:
    /** @return another byte for each object, so that a copy of another object's room is noticed */
    static unsigned char nextFill()
    {
        static unsigned char fill = 0xA0;
        return ++fill;
    }

    static constexpr std::size_t room = 256;

    unsigned char const fill_ = nextFill();
    alignas(std::max_align_t) unsigned char bytes_[sizeof(Object) + room];
    Object* object_;
};

} // namespace hostcheck

#endif
