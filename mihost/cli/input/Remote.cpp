#include "mihost/cli/input/Remote.h"

#include "mihost/cli/input/ShellWords.h"
#include "mihost/cli/system/Failure.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

/** Of mihost and of ssh: nothing after it is an option. */
constexpr char endOfOptions[] = "--";

/** How many words from here on name the host: 2 for "--host HOST", 1 for "--host=HOST". */
std::size_t hostWordsAt(std::vector<std::string> const& words, std::size_t at,
                        std::string const& host)
{
    std::string const& word = words[at];
    bool const isName = word == "--host" || word == "-H";
    if (isName && at + 1 < words.size() && words[at + 1] == host)
        return 2;
    return word == "--host=" + host || word == "-H" + host ? 1 : 0;
}

std::vector<std::string> terminalOptions(RemoteTerminal terminal)
{
    switch (terminal) {
    case RemoteTerminal::Use:
        // Or ssh would add "Connection to HOST closed." to what the command prints.
        return {"-t", "-o", "LogLevel=ERROR"};
    case RemoteTerminal::None:
        return {"-T"};
    case RemoteTerminal::Ignore:
        return {"-T", "-n"};
    }
    return {};
}

} // namespace

std::vector<std::string> withoutHost(std::vector<std::string> const& words, std::string const& host)
{
    for (std::size_t at = 0; at < words.size() && words[at] != endOfOptions; ++at)
        if (std::size_t const count = hostWordsAt(words, at, host); count != 0) {
            auto rest = words;
            auto const first = rest.begin() + static_cast<std::ptrdiff_t>(at);
            rest.erase(first, first + static_cast<std::ptrdiff_t>(count));
            return rest;
        }
    throw Failure(BadUsage,
                  "--host: it is part of another argument (write --host HOST separately)");
}

void expectHost(std::string const& host)
{
    bool const isOdd =
        host.empty() || host[0] == '-' ||
        std::any_of(host.begin(), host.end(), [](char byte) { return byte >= 0 && byte <= ' '; });
    if (isOdd)
        throw Failure(BadUsage,
                      fmt::format("--host: '{}' is not a host (write [USER@]HOST)", host));
}

std::vector<std::string> remoteCommand(std::string const& host,
                                       std::vector<std::string> const& words,
                                       RemoteTerminal terminal)
{
    // exec leaves no shell in between, which would report the signal instead of the status after
    // Ctrl-C.
    std::string line = "exec mihost";
    for (std::string const& word : words)
        line += ' ' + quotedForShell(word);
    std::vector<std::string> command = {"ssh"};
    std::vector<std::string> const options = terminalOptions(terminal);
    command.insert(command.end(), options.begin(), options.end());
    command.insert(command.end(), {endOfOptions, host, line});
    return command;
}

} // namespace mihost
