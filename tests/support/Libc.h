#ifndef TESTS_SUPPORT_LIBC_H
#define TESTS_SUPPORT_LIBC_H

#include <cstdio>
#include <ctime>
#include <deque>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <sys/types.h>
#include <vector>

struct group;
struct passwd;
struct spwd;
struct statfs;
struct sysinfo;
struct utsname;

/**
 * The libc calls that the plug-in makes, replaced in the test program.
 *
 * Each hook that is set is asked in place of the real call; those not set fall through to it.
 */
namespace libc
{

struct Hooks {
    std::function<FILE*(char const* command, char const* mode)> popen;
    std::function<int(FILE* stream)> pclose;
    std::function<FILE*(char const* path, char const* mode)> fopen;
    std::function<int(struct sysinfo* figures)> sysinfo;
    std::function<int(struct utsname* system)> uname;
    std::function<int()> lckpwdf;
    std::function<int()> ulckpwdf;
    std::function<void()> setpwent;
    std::function<void()> endpwent;
    std::function<int(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
                      struct passwd** found)>
        fgetpwent_r;
    std::function<int(FILE* stream, struct spwd* entry, char* buffer, std::size_t size,
                      struct spwd** found)>
        fgetspent_r;
    std::function<char*(char* buffer, int size, FILE* stream)> fgets;
    std::function<std::time_t()> time;
    std::function<std::time_t(std::tm* fields)> mktime;
    std::function<void()> setgrent;
    std::function<struct group*()> getgrent;
    std::function<void()> endgrent;
    std::function<int(clockid_t clock, timespec* now)> clock_gettime;
    std::function<ssize_t(int descriptor, void* buffer, std::size_t size, off_t offset)> pread;
    std::function<int(int descriptor, struct statfs* system)> fstatfs;
    std::function<uid_t()> geteuid;
};

Hooks& hooks();

/** The real calls, past the hooks. */
FILE* realPopen(char const* command, char const* mode);
int realPclose(FILE* stream);
FILE* realFopen(char const* path, char const* mode);
int realSysinfo(struct sysinfo* figures);
int realFgetpwent_r(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
                    struct passwd** found);
int realFgetspent_r(FILE* stream, struct spwd* entry, char* buffer, std::size_t size,
                    struct spwd** found);
char* realFgets(char* buffer, int size, FILE* stream);
int realUname(struct utsname* system);
std::time_t realMktime(std::tm* fields);
int realClockGettime(clockid_t clock, timespec* now);
ssize_t realPread(int descriptor, void* buffer, std::size_t size, off_t offset);
int realFstatfs(int descriptor, struct statfs* system);

/** From now on this command, and it alone, cannot be started: popen yields null. */
void refuse(std::string const& command);

/** Takes all hooks away when it goes. */
class HookGuard
{
public:
    HookGuard();
    ~HookGuard();
    HookGuard(HookGuard const&) = delete;
    HookGuard& operator=(HookGuard const&) = delete;
};

/** Counts the bytes that pread reads from now on. */
class ReadCounter
{
public:
    ReadCounter();

    std::size_t bytes() const;
    void reset();

private:
    HookGuard guard_;
    std::size_t bytes_ = 0;
};

/**
 * Lays files over the machine's own for as long as it lives: opening any path below /etc or
 * /var/log opens it below the root folder instead, and the group database is the root folder's
 * /etc/group. The machine's account lock is not taken.
 */
class FileRoot
{
public:
    explicit FileRoot(std::string root);
    ~FileRoot();
    FileRoot(FileRoot const&) = delete;
    FileRoot& operator=(FileRoot const&) = delete;
};

/**
 * Answers commands with recorded output for as long as it lives, and notes every command asked for.
 *
 * A command that has no answer cannot be started: popen yields null.
 */
class FakeCommands
{
public:
    FakeCommands();
    ~FakeCommands();
    FakeCommands(FakeCommands const&) = delete;
    FakeCommands& operator=(FakeCommands const&) = delete;

    std::map<std::string, std::string> answers;

    /** Answers for the first runs of a command, in turn; later ones get that of answers. */
    std::map<std::string, std::deque<std::string>> first;

    /** What commands without an answer of their own print. */
    std::optional<std::string> otherwise;

    std::vector<std::string> ran;

    /** The modes asked for, one for each command. */
    std::vector<std::string> modes;

    /** Streams handed out and not closed yet. */
    int open = 0;
};

} // namespace libc

#endif
