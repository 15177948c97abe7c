#include "tests/support/Libc.h"

#include "tests/support/Next.h"

#include <grp.h>
#include <memory>
#include <pwd.h>
#include <shadow.h>
#include <sys/sysinfo.h>
#include <sys/utsname.h>
#include <sys/vfs.h>
#include <unistd.h>

namespace libc
{

namespace
{

/** Fake output as a stream; unlike an in-memory stream it holds NUL bytes and emptiness well. */
FILE* streamOf(std::string const& text)
{
    FILE* stream = std::tmpfile();
    std::fwrite(text.data(), 1, text.size(), stream);
    std::rewind(stream);
    return stream;
}

/** A group database that stands in one file; read from its start after a rewind. */
class GroupFile
{
public:
    explicit GroupFile(std::string path) : path_(std::move(path)) {}
    ~GroupFile()
    {
        close();
    }
    GroupFile(GroupFile const&) = delete;
    GroupFile& operator=(GroupFile const&) = delete;

    void rewind()
    {
        close();
        stream_ = realFopen(path_.c_str(), "r");
    }

    group* next()
    {
        if (!stream_)
            rewind();
        return stream_ ? fgetgrent(stream_) : nullptr;
    }

    void close()
    {
        if (stream_)
            std::fclose(stream_);
        stream_ = nullptr;
    }

private:
    std::string const path_;
    FILE* stream_ = nullptr;
};

} // namespace

Hooks& hooks()
{
    static Hooks inUse;
    return inUse;
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

FILE* realFopen(char const* path, char const* mode)
{
    static auto* const real = next<FILE*(char const*, char const*)>("fopen");
    return real(path, mode);
}

int realSysinfo(struct sysinfo* figures)
{
    static auto* const real = next<int(struct sysinfo*)>("sysinfo");
    return real(figures);
}

int realFgetpwent_r(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
                    struct passwd** found)
{
    static auto* const real =
        next<int(FILE*, struct passwd*, char*, std::size_t, struct passwd**)>("fgetpwent_r");
    return real(stream, entry, buffer, size, found);
}

int realFgetspent_r(FILE* stream, struct spwd* entry, char* buffer, std::size_t size,
                    struct spwd** found)
{
    static auto* const real =
        next<int(FILE*, struct spwd*, char*, std::size_t, struct spwd**)>("fgetspent_r");
    return real(stream, entry, buffer, size, found);
}

char* realFgets(char* buffer, int size, FILE* stream)
{
    static auto* const real = next<char*(char*, int, FILE*)>("fgets");
    return real(buffer, size, stream);
}

int realUname(struct utsname* system)
{
    static auto* const real = next<int(struct utsname*)>("uname");
    return real(system);
}

std::time_t realMktime(std::tm* fields)
{
    static auto* const real = next<std::time_t(std::tm*)>("mktime");
    return real(fields);
}

int realClockGettime(clockid_t clock, timespec* now)
{
    static auto* const real = next<int(clockid_t, timespec*)>("clock_gettime");
    return real(clock, now);
}

ssize_t realPread(int descriptor, void* buffer, std::size_t size, off_t offset)
{
    static auto* const real = next<ssize_t(int, void*, std::size_t, off_t)>("pread");
    return real(descriptor, buffer, size, offset);
}

int realFstatfs(int descriptor, struct statfs* system)
{
    static auto* const real = next<int(int, struct statfs*)>("fstatfs");
    return real(descriptor, system);
}

void refuse(std::string const& command)
{
    hooks().popen = [command](char const* asked, char const* mode) -> FILE* {
        return asked == command ? nullptr : realPopen(asked, mode);
    };
}

HookGuard::HookGuard() = default;

HookGuard::~HookGuard()
{
    hooks() = {};
}

ReadCounter::ReadCounter()
{
    hooks().pread = [this](int descriptor, void* buffer, std::size_t size, off_t offset) {
        ssize_t const got = realPread(descriptor, buffer, size, offset);
        bytes_ += static_cast<std::size_t>(got > 0 ? got : 0);
        return got;
    };
}

std::size_t ReadCounter::bytes() const
{
    return bytes_;
}

void ReadCounter::reset()
{
    bytes_ = 0;
}

FileRoot::FileRoot(std::string root)
{
    auto const groups = std::make_shared<GroupFile>(root + "/etc/group");
    hooks().setgrent = [groups] { groups->rewind(); };
    hooks().getgrent = [groups] { return groups->next(); };
    hooks().endgrent = [groups] { groups->close(); };
    if (!hooks().lckpwdf)
        hooks().lckpwdf = [] { return 0; };
    if (!hooks().ulckpwdf)
        hooks().ulckpwdf = [] { return 0; };
    hooks().fopen = [root = std::move(root)](char const* path, char const* mode) {
        std::string const asked = path;
        bool const below = asked.rfind("/etc/", 0) == 0 || asked.rfind("/var/log/", 0) == 0;
        return realFopen(below ? (root + asked).c_str() : path, mode);
    };
}

FileRoot::~FileRoot()
{
    hooks().fopen = nullptr;
    hooks().ulckpwdf = nullptr;
    hooks().lckpwdf = nullptr;
    hooks().endgrent = nullptr;
    hooks().getgrent = nullptr;
    hooks().setgrent = nullptr;
}

FakeCommands::FakeCommands()
{
    hooks().popen = [this](char const* command, char const* mode) -> FILE* {
        ran.emplace_back(command);
        modes.emplace_back(mode);
        std::deque<std::string>& turns = first[command];
        auto const answer = answers.find(command);
        if (turns.empty() && answer == answers.end() && !otherwise)
            return nullptr;
        ++open;
        if (turns.empty())
            return streamOf(answer == answers.end() ? *otherwise : answer->second);
        std::string const output = turns.front();
        turns.pop_front();
        return streamOf(output);
    };
    hooks().pclose = [this](FILE* stream) {
        --open;
        return std::fclose(stream);
    };
}

FakeCommands::~FakeCommands()
{
    hooks().popen = nullptr;
    hooks().pclose = nullptr;
}

} // namespace libc

using libc::hooks;

extern "C" {

FILE* popen(char const* command, char const* mode)
{
    return hooks().popen ? hooks().popen(command, mode) : libc::realPopen(command, mode);
}

int pclose(FILE* stream)
{
    return hooks().pclose ? hooks().pclose(stream) : libc::realPclose(stream);
}

FILE* fopen(char const* path, char const* mode)
{
    return hooks().fopen ? hooks().fopen(path, mode) : libc::realFopen(path, mode);
}

// File streams open through this name.
FILE* fopen64(char const* path, char const* mode)
{
    return fopen(path, mode);
}

int sysinfo(struct sysinfo* figures) noexcept
{
    return hooks().sysinfo ? hooks().sysinfo(figures) : libc::realSysinfo(figures);
}

int uname(struct utsname* system) noexcept
{
    return hooks().uname ? hooks().uname(system) : libc::realUname(system);
}

int lckpwdf() noexcept
{
    static auto* const real = next<int()>("lckpwdf");
    return hooks().lckpwdf ? hooks().lckpwdf() : real();
}

int ulckpwdf() noexcept
{
    static auto* const real = next<int()>("ulckpwdf");
    return hooks().ulckpwdf ? hooks().ulckpwdf() : real();
}

void setpwent()
{
    static auto* const real = next<void()>("setpwent");
    return hooks().setpwent ? hooks().setpwent() : real();
}

void endpwent()
{
    static auto* const real = next<void()>("endpwent");
    return hooks().endpwent ? hooks().endpwent() : real();
}

int fgetpwent_r(FILE* stream, struct passwd* entry, char* buffer, std::size_t size,
                struct passwd** found)
{
    return hooks().fgetpwent_r ? hooks().fgetpwent_r(stream, entry, buffer, size, found)
                               : libc::realFgetpwent_r(stream, entry, buffer, size, found);
}

int fgetspent_r(FILE* stream, struct spwd* entry, char* buffer, std::size_t size,
                struct spwd** found)
{
    return hooks().fgetspent_r ? hooks().fgetspent_r(stream, entry, buffer, size, found)
                               : libc::realFgetspent_r(stream, entry, buffer, size, found);
}

char* fgets(char* buffer, int size, FILE* stream)
{
    return hooks().fgets ? hooks().fgets(buffer, size, stream)
                         : libc::realFgets(buffer, size, stream);
}

time_t time(time_t* out) noexcept
{
    static auto* const real = next<time_t(time_t*)>("time");
    time_t const now = hooks().time ? hooks().time() : real(nullptr);
    if (out)
        *out = now;
    return now;
}

time_t mktime(std::tm* fields) noexcept
{
    return hooks().mktime ? hooks().mktime(fields) : libc::realMktime(fields);
}

void setgrent()
{
    static auto* const real = next<void()>("setgrent");
    hooks().setgrent ? hooks().setgrent() : real();
}

struct group* getgrent()
{
    static auto* const real = next<group*()>("getgrent");
    return hooks().getgrent ? hooks().getgrent() : real();
}

void endgrent()
{
    static auto* const real = next<void()>("endgrent");
    hooks().endgrent ? hooks().endgrent() : real();
}

int clock_gettime(clockid_t clock, timespec* now) noexcept
{
    return hooks().clock_gettime ? hooks().clock_gettime(clock, now)
                                 : libc::realClockGettime(clock, now);
}

ssize_t pread(int descriptor, void* buffer, std::size_t size, off_t offset)
{
    return hooks().pread ? hooks().pread(descriptor, buffer, size, offset)
                         : libc::realPread(descriptor, buffer, size, offset);
}

int fstatfs(int descriptor, struct statfs* system) noexcept
{
    return hooks().fstatfs ? hooks().fstatfs(descriptor, system)
                           : libc::realFstatfs(descriptor, system);
}

uid_t geteuid() noexcept
{
    static auto* const real = next<uid_t()>("geteuid");
    return hooks().geteuid ? hooks().geteuid() : real();
}

} // extern "C"
