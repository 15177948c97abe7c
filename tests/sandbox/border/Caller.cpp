#include "tests/sandbox/border/Caller.h"

#include "tests/support/Sandbox.h"

#include <csignal>
#include <sched.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{
constexpr int refused = 99;
}

int Caller::writer = -1;

Caller::Caller(Inside inside, std::string const& overlay, std::function<void()> const& before)
    : process_(-1)
{
    int ends[2];
    if (pipe(ends) != 0)
        throw std::runtime_error("no pipe");
    readEnd_ = mihost::Descriptor(ends[0]);
    mihost::Descriptor writeEnd(ends[1]);
    process_ = fork();
    if (process_ != 0)
        return;
    readEnd_.reset();
    writer = writeEnd.get();
    before();
    if (auto const reason = mihost::enterSandbox(overlay)) {
        say(*reason);
        _exit(refused);
    }
    _exit(inside());
}

Caller::~Caller()
{
    if (process_ <= 0)
        return;
    kill(process_, SIGKILL);
    waitpid(process_, nullptr, 0);
}

void Caller::say(std::string const& text)
{
    if (::write(writer, text.data(), text.size()) < 0)
        _exit(refused);
}

void Caller::sayAndWait()
{
    say(".");
    for (;;)
        pause();
}

void Caller::sayWorkingDirectory()
{
    char path[4096] = "";
    say(getcwd(path, sizeof path) ? path : "none");
}

std::string Caller::hear(std::size_t length)
{
    std::string text(length, '\0');
    std::size_t got = 0;
    while (got < length) {
        ssize_t const count = read(readEnd_.get(), text.data() + got, length - got);
        if (count <= 0)
            break;
        got += static_cast<std::size_t>(count);
    }
    text.resize(got);
    return text;
}

std::string Caller::hearAll()
{
    std::string text;
    for (std::string next; !(next = hear(1)).empty();)
        text += next;
    return text;
}

void Caller::send(int signal) const
{
    kill(process_, signal);
}

int Caller::wait()
{
    int status = 0;
    waitpid(std::exchange(process_, -1), &status, 0);
    return status;
}

void ownMounts()
{
    if (unshare(CLONE_NEWNS) != 0 ||
        mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0)
        _exit(1);
}

void mountOwnDisk(std::string const& path)
{
    ownMounts();
    if (mount("tmpfs", path.c_str(), "tmpfs", 0, "") != 0)
        _exit(1);
}

void continueInChild(std::function<void()> const& atItsEnd)
{
    if (pid_t const child = fork()) {
        int status = 0;
        waitpid(child, &status, 0);
        atItsEnd();
        _exit(WEXITSTATUS(status));
    }
}

bool exists(std::string const& path)
{
    struct stat status {
    };
    return lstat(path.c_str(), &status) == 0;
}

void BorderTest::SetUp()
{
    Caller caller([] { return 0; });
    std::string const reason = caller.hearAll();
    if (caller.wait() == 0)
        return;
    if (sandboxIsRequired())
        FAIL() << "no sandbox: " << reason;
    GTEST_SKIP() << "no sandbox: " << reason;
}
