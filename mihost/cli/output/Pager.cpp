#include "mihost/cli/output/Pager.h"

#include "mihost/cli/system/CommandLocale.h"
#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/Stderr.h"
#include "mihost/sandbox/Descriptor.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <fmt/format.h>
#include <iterator>
#include <spawn.h>
#include <sys/wait.h>
#include <termios.h>
#include <unistd.h>
#include <vector>

namespace mihost
{

namespace
{

/** What a shell exits with if it cannot run a command, or does not find it. */
constexpr int cannotRun = 126;
constexpr int cannotFind = 127;

/** While it exists, only the pager gets Ctrl-C and Ctrl-\. */
class SignalsForPager
{
public:
    SignalsForPager()
    {
        struct sigaction ignored {
        };
        ignored.sa_handler = SIG_IGN;
        sigaction(SIGINT, &ignored, &interrupt_);
        sigaction(SIGQUIT, &ignored, &quit_);
    }
    ~SignalsForPager()
    {
        sigaction(SIGINT, &interrupt_, nullptr);
        sigaction(SIGQUIT, &quit_, nullptr);
    }
    SignalsForPager(SignalsForPager const&) = delete;
    SignalsForPager& operator=(SignalsForPager const&) = delete;

private:
    struct sigaction interrupt_ {
    };
    struct sigaction quit_ {
    };
};

/** Restores the terminal's settings, even if the pager or this program is killed. */
class TerminalSettings
{
public:
    TerminalSettings()
    {
        tcgetattr(STDIN_FILENO, &before_);
        interrupts::setTerminalToRestore(&before_);
    }
    ~TerminalSettings()
    {
        tcsetattr(STDIN_FILENO, TCSADRAIN, &before_);
        interrupts::setTerminalToRestore(nullptr);
    }
    TerminalSettings(TerminalSettings const&) = delete;
    TerminalSettings& operator=(TerminalSettings const&) = delete;

private:
    termios before_{};
};

/** Whether sudo, doas or pkexec started this program. */
bool isRunForAnotherUser()
{
    constexpr char const* variables[] = {"SUDO_UID", "DOAS_USER", "PKEXEC_UID"};
    return std::any_of(std::begin(variables), std::end(variables),
                       [](char const* name) { return std::getenv(name) != nullptr; });
}

/** The variables of the pager: the user's, and some that pagers read unless the user set them. */
std::vector<std::string> pagerEnvironment()
{
    std::vector<std::string> variables = userEnvironment();
    auto const setUnlessSet = [&variables](char const* name, char const* value) {
        if (!std::getenv(name))
            variables.push_back(fmt::format("{}={}", name, value));
    };
    setUnlessSet("LESS", "FRX"); // leave if all fits, show colours, keep the screen
    setUnlessSet("LV", "-c");
    if (isRunForAnotherUser()) // who may not be permitted to run a shell
        setUnlessSet("LESSSECURE", "1");
    return variables;
}

/** @return 0, or why the pager was not started */
int start(std::string command, int input, pid_t& child)
{
    std::string shell = "sh";
    std::string option = "-c";
    char* const arguments[] = {shell.data(), option.data(), command.data(), nullptr};
    std::vector<std::string> variables = pagerEnvironment();
    std::vector<char*> environment;
    environment.reserve(variables.size() + 1);
    for (std::string& variable : variables)
        environment.push_back(variable.data());
    environment.push_back(nullptr);

    posix_spawn_file_actions_t files;
    posix_spawnattr_t attributes;
    sigset_t standard;
    sigemptyset(&standard);
    sigaddset(&standard, SIGINT);
    sigaddset(&standard, SIGQUIT);
    posix_spawn_file_actions_init(&files);
    posix_spawn_file_actions_adddup2(&files, input, STDIN_FILENO);
    posix_spawnattr_init(&attributes);
    posix_spawnattr_setsigdefault(&attributes, &standard);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGDEF);
    int const problem =
        posix_spawn(&child, "/bin/sh", &files, &attributes, arguments, environment.data());
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&files);
    return problem;
}

/** Writes until the pager reads no more. */
void writeTo(Descriptor const& pipe, std::string_view text)
{
    while (!text.empty()) {
        ssize_t const count = write(pipe.get(), text.data(), text.size());
        if (count < 0 && errno != EINTR)
            return;
        text.remove_prefix(count < 0 ? 0 : static_cast<std::size_t>(count));
    }
}

int waitFor(pid_t child)
{
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : 0;
}

} // namespace

std::string pagerCommand()
{
    char const* command = std::getenv("MIHOST_PAGER");
    if (!command)
        command = std::getenv("PAGER");
    if (!command)
        command = "less";
    return command == std::string_view("cat") ? "" : command;
}

bool showInPager(std::string const& command, std::string const& text)
{
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0)
        return false;
    Descriptor readEnd(ends[0]);
    Descriptor writeEnd(ends[1]);
    TerminalSettings const settings;
    SignalsForPager const signals;
    pid_t child = -1;
    if (start(command, readEnd.get(), child) != 0)
        return false;
    readEnd.reset();
    writeTo(writeEnd, text);
    writeEnd.reset();
    int const code = waitFor(child);
    bool const isShown = code != cannotRun && code != cannotFind;
    if (!isShown)
        warn(fmt::format("showing the output in '{}': cannot run it (set MIHOST_PAGER)", command));
    return isShown;
}

} // namespace mihost
