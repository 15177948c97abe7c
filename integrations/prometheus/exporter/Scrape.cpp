#include "integrations/prometheus/exporter/Scrape.h"

#include "mihost/sandbox/Descriptor.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using mihost::Descriptor;
using Clock = std::chrono::steady_clock;

/** A started program, which is killed and waited for in the end. */
class Child
{
public:
    Child(std::vector<std::string> const& command, int output)
    {
        std::vector<char*> arguments;
        arguments.reserve(command.size() + 1);
        for (std::string const& argument : command)
            arguments.push_back(const_cast<char*>(argument.c_str()));
        arguments.push_back(nullptr);
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
        posix_spawnattr_t attributes;
        posix_spawnattr_init(&attributes);
        // Its own process group, so that its commands are killed with it. It does not inherit
        // blocked signals, so that systemd can end it.
        sigset_t none;
        sigemptyset(&none);
        posix_spawnattr_setsigmask(&attributes, &none);
        posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETPGROUP | POSIX_SPAWN_SETSIGMASK);
        if (posix_spawn(&pid_, arguments[0], &actions, &attributes, arguments.data(), environ) != 0)
            pid_ = -1;
        posix_spawnattr_destroy(&attributes);
        posix_spawn_file_actions_destroy(&actions);
    }
    ~Child()
    {
        if (pid_ < 0)
            return;
        kill(-pid_, SIGKILL);
        while (waitpid(pid_, nullptr, 0) < 0 && errno == EINTR) {
        }
    }
    Child(Child const&) = delete;
    Child& operator=(Child const&) = delete;

    bool isStarted() const
    {
        return pid_ >= 0;
    }

private:
    pid_t pid_ = -1;
};

/** Whether there is something to read, or the end, before the deadline. */
bool isReadable(int file, Clock::time_point deadline)
{
    for (;;) {
        auto const left =
            std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
        if (left <= 0)
            return false;
        pollfd watched{file, POLLIN, 0};
        int const count = poll(&watched, 1, static_cast<int>(left));
        if (count > 0)
            return true;
        if (count < 0 && errno != EINTR)
            return false;
    }
}

} // namespace

std::optional<std::string> scrape(std::vector<std::string> const& command,
                                  std::chrono::milliseconds timeLimit)
{
    auto const deadline = Clock::now() + timeLimit;
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0)
        return std::nullopt;
    Descriptor const readEnd(ends[0]);
    Descriptor writeEnd(ends[1]);
    Child const child(command, writeEnd.get());
    writeEnd.reset();
    if (!child.isStarted())
        return std::nullopt;
    std::string text;
    while (isReadable(readEnd.get(), deadline)) {
        std::array<char, 16384> block{};
        ssize_t const length = read(readEnd.get(), block.data(), block.size());
        if (length > 0)
            text.append(block.data(), static_cast<std::size_t>(length));
        else if (length == 0)
            return text.empty() ? std::nullopt : std::optional(text);
        else if (errno != EINTR)
            return std::nullopt;
    }
    return std::nullopt;
}
