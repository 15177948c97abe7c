#ifndef TESTS_INTERPOSE_LIBC_H
#define TESTS_INTERPOSE_LIBC_H

#include "tests/interpose/Call.h"
#include "tests/interpose/Real.h"

#include <cstdio>
#include <ctime>
#include <string>
#include <sys/types.h>

struct group;
struct passwd;
struct spwd;
struct stat;
struct statfs;
struct sysinfo;
struct utsname;

/** The libc functions that the plug-in and the program call, replaced in the test program. */
namespace libc
{

using interpose::Call;

struct Hooks {
    Call<FILE*(char const* command, char const* mode)> popen{"popen"};
    Call<int(FILE* stream)> pclose{"pclose", -1};
    Call<FILE*(char const* path, char const* mode)> fopen{"fopen"};
    Call<int(FILE* stream)> fclose{"fclose", EOF};
    Call<int(struct sysinfo* figures)> sysinfo{"sysinfo", -1};
    Call<int(struct utsname* system)> uname{"uname", -1};
    Call<int()> lckpwdf{"lckpwdf", -1};
    Call<int()> ulckpwdf{"ulckpwdf", -1};
    Call<void()> setpwent{"setpwent"};
    Call<void()> endpwent{"endpwent"};
    Call<int(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
             struct passwd** found)>
        fgetpwent_r{"fgetpwent_r", EIO};
    Call<int(FILE* stream, struct spwd* entry, char* buffer, std::size_t size, struct spwd** found)>
        fgetspent_r{"fgetspent_r", EIO};
    Call<char*(char* buffer, int size, FILE* stream)> fgets{"fgets"};
    Call<std::time_t(std::time_t* out)> time{"time", -1};
    Call<std::time_t(std::tm* fields)> mktime{"mktime", -1};
    Call<void()> setgrent{"setgrent"};
    Call<struct group*()> getgrent{"getgrent"};
    Call<void()> endgrent{"endgrent"};
    Call<int(clockid_t clock, timespec* now)> clock_gettime{"clock_gettime", -1};
    Call<ssize_t(int descriptor, void* buffer, std::size_t size, off_t offset)> pread{"pread", -1};
    Call<int(int descriptor, struct statfs* system)> fstatfs{"fstatfs", -1};
    Call<int(int directory, char const* path, struct stat* status, int flags)> fstatat{"fstatat",
                                                                                       -1};
    Call<uid_t()> geteuid{"geteuid"};
};

Hooks& hooks();

/** From now on popen returns null for this command, and only for it. */
void refuse(std::string const& command);

/** Removes all hooks when it is destroyed. */
class HookGuard
{
public:
    HookGuard();
    ~HookGuard();
    HookGuard(HookGuard const&) = delete;
    HookGuard& operator=(HookGuard const&) = delete;
};

} // namespace libc

#endif
