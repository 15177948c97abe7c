#ifndef MIHOST_CLI_INPUT_REMOTE_H
#define MIHOST_CLI_INPUT_REMOTE_H

#include <string>
#include <vector>

namespace mihost
{

/** What ssh is to do with the terminal. */
enum class RemoteTerminal {
    Use,   // a terminal there, too: a person here sees the output
    None,  // streams only
    Ignore // nothing is read, since typed text, including passwords, would be echoed
};

/**
 * The words without the option for the host.
 *
 * @param host  as parsed
 * @throws Failure (BadUsage) if it is part of another word
 */
std::vector<std::string> withoutHost(std::vector<std::string> const& words,
                                     std::string const& host);

/** @throws Failure (BadUsage) for a text that ssh would not take for a host */
void expectHost(std::string const& host);

/** The arguments, "ssh" first, that run mihost with these words on a host. */
std::vector<std::string> remoteCommand(std::string const& host,
                                       std::vector<std::string> const& words,
                                       RemoteTerminal terminal);

} // namespace mihost

#endif
