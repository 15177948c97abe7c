#include "tests/faults/Faults.h"

#include "tests/support/Libc.h"

#include <cerrno>
#include <cstdlib>
#include <new>

namespace faults
{

namespace
{

// Plain numbers: the allocation functions below must not allocate.
bool armed = false;
bool inHook = false;
Call armedCall = Call::count;
unsigned long failAt = 0;
unsigned long made = 0;

/** What a hook does on its own account is not counted. */
class InHook
{
public:
    InHook() : before_(inHook)
    {
        inHook = true;
    }
    ~InHook()
    {
        inHook = before_;
    }
    InHook(InHook const&) = delete;
    InHook& operator=(InHook const&) = delete;

private:
    bool const before_;
};

template <class Type> struct Same {
    using type = Type;
};

/** @param real  what to call where no hook is set */
template <class Result, class... Arguments>
void wrap(std::function<Result(Arguments...)>& hook, Call call, typename Same<Result>::type failure,
          typename Same<Result (*)(Arguments...)>::type real = nullptr)
{
    hook = [inner = hook, call, failure, real](Arguments... arguments) {
        if (failsNow(call)) {
            errno = EIO;
            return failure;
        }
        InHook const inside;
        return inner ? inner(arguments...) : real(arguments...);
    };
}

} // namespace

std::string nameOf(Call call)
{
    static char const* const names[] = {"popen",    "fopen",     "fgets",       "sysinfo",
                                        "uname",    "lckpwdf",   "fgetpwent_r", "fgetspent_r",
                                        "getgrent", "allocation"};
    return names[static_cast<int>(call)];
}

void arm(Call call, unsigned long at)
{
    armedCall = call;
    failAt = at;
    made = 0;
    armed = true;
}

unsigned long disarm()
{
    armed = false;
    return made;
}

bool failsNow(Call call)
{
    return armed && !inHook && call == armedCall && ++made == failAt;
}

void wrapHooks()
{
    libc::Hooks& hooks = libc::hooks();
    wrap(hooks.popen, Call::Popen, nullptr, libc::realPopen);
    wrap(hooks.pclose, Call::count, 0, libc::realPclose);
    wrap(hooks.fopen, Call::Fopen, nullptr, libc::realFopen);
    wrap(hooks.fgets, Call::Fgets, nullptr, libc::realFgets);
    wrap(hooks.sysinfo, Call::Sysinfo, -1, libc::realSysinfo);
    wrap(hooks.uname, Call::Uname, -1, libc::realUname);
    wrap(hooks.lckpwdf, Call::Lckpwdf, -1);
    wrap(hooks.ulckpwdf, Call::count, 0);
    wrap(hooks.fgetpwent_r, Call::ReadPasswd, EIO, libc::realFgetpwent_r);
    wrap(hooks.fgetspent_r, Call::ReadShadow, EIO, libc::realFgetspent_r);
    wrap(hooks.getgrent, Call::ReadGroup, nullptr);
}

} // namespace faults

namespace
{

void* allocate(std::size_t size)
{
    if (faults::failsNow(faults::Call::Allocation))
        throw std::bad_alloc();
    void* const memory = std::malloc(size == 0 ? 1 : size);
    if (!memory)
        throw std::bad_alloc();
    return memory;
}

} // namespace

void* operator new(std::size_t size)
{
    return allocate(size);
}

void* operator new[](std::size_t size)
{
    return allocate(size);
}

void operator delete(void* memory) noexcept
{
    std::free(memory);
}

void operator delete[](void* memory) noexcept
{
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept
{
    std::free(memory);
}

void operator delete[](void* memory, std::size_t) noexcept
{
    std::free(memory);
}
