#include "tests/interpose/Libc.h"

#include <grp.h>
#include <pwd.h>
#include <shadow.h>
#include <sys/stat.h>
#include <sys/sysinfo.h>
#include <sys/utsname.h>
#include <sys/vfs.h>
#include <unistd.h>

namespace libc
{

Hooks& hooks()
{
    static Hooks inUse;
    return inUse;
}

void refuse(std::string const& command)
{
    hooks().popen = [command](char const* asked, char const* mode) -> FILE* {
        return asked == command ? nullptr : interpose::real(::popen)(asked, mode);
    };
}

HookGuard::HookGuard() = default;

HookGuard::~HookGuard()
{
    interpose::resetAll();
}

} // namespace libc

using interpose::real;
using libc::hooks;

extern "C" {

FILE* popen(char const* command, char const* mode)
{
    static auto* const next = real(popen);
    return hooks().popen(next, command, mode);
}

int pclose(FILE* stream)
{
    static auto* const next = real(pclose);
    return hooks().pclose(next, stream);
}

FILE* fopen(char const* path, char const* mode)
{
    static auto* const next = real(fopen);
    return hooks().fopen(next, path, mode);
}

// File streams open through this name.
FILE* fopen64(char const* path, char const* mode)
{
    return fopen(path, mode);
}

int fclose(FILE* stream)
{
    static auto* const next = real(fclose);
    return hooks().fclose(next, stream);
}

int sysinfo(struct sysinfo* figures) noexcept
{
    static auto* const next = real(sysinfo);
    return hooks().sysinfo(next, figures);
}

int uname(struct utsname* system) noexcept
{
    static auto* const next = real(uname);
    return hooks().uname(next, system);
}

int lckpwdf() noexcept
{
    static auto* const next = real(lckpwdf);
    return hooks().lckpwdf(next);
}

int ulckpwdf() noexcept
{
    static auto* const next = real(ulckpwdf);
    return hooks().ulckpwdf(next);
}

void setpwent()
{
    static auto* const next = real(setpwent);
    hooks().setpwent(next);
}

void endpwent()
{
    static auto* const next = real(endpwent);
    hooks().endpwent(next);
}

int fgetpwent_r(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
                struct passwd** found)
{
    static auto* const next = real(fgetpwent_r);
    return hooks().fgetpwent_r(next, stream, entry, buffer, size, found);
}

int fgetspent_r(FILE* stream, struct spwd* entry, char* buffer, std::size_t size,
                struct spwd** found)
{
    static auto* const next = real(fgetspent_r);
    return hooks().fgetspent_r(next, stream, entry, buffer, size, found);
}

char* fgets(char* buffer, int size, FILE* stream)
{
    static auto* const next = real(fgets);
    return hooks().fgets(next, buffer, size, stream);
}

time_t time(time_t* out) noexcept
{
    static auto* const next = real(time);
    time_t const now = hooks().time(next, nullptr);
    if (out)
        *out = now;
    return now;
}

time_t mktime(std::tm* fields) noexcept
{
    static auto* const next = real(mktime);
    return hooks().mktime(next, fields);
}

void setgrent()
{
    static auto* const next = real(setgrent);
    hooks().setgrent(next);
}

struct group* getgrent()
{
    static auto* const next = real(getgrent);
    return hooks().getgrent(next);
}

void endgrent()
{
    static auto* const next = real(endgrent);
    hooks().endgrent(next);
}

int clock_gettime(clockid_t clock, timespec* now) noexcept
{
    static auto* const next = real(clock_gettime);
    return hooks().clock_gettime(next, clock, now);
}

ssize_t pread(int descriptor, void* buffer, std::size_t size, off_t offset)
{
    static auto* const next = real(pread);
    return hooks().pread(next, descriptor, buffer, size, offset);
}

int fstatfs(int descriptor, struct statfs* system) noexcept
{
    static auto* const next = real(fstatfs);
    return hooks().fstatfs(next, descriptor, system);
}

int fstatat(int directory, char const* path, struct stat* status, int flags) noexcept
{
    static auto* const next = real(fstatat);
    return hooks().fstatat(next, directory, path, status, flags);
}

uid_t geteuid() noexcept
{
    static auto* const next = real(geteuid);
    return hooks().geteuid(next);
}

} // extern "C"
