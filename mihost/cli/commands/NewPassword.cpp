#include "mihost/cli/commands/NewPassword.h"

#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/TextFile.h"

#include <cerrno>
#include <cstring>
#include <fmt/format.h>
#include <fstream>
#include <sstream>

namespace mihost
{

namespace
{

std::string askTwice()
{
    std::string password = terminal::readSecret("New password");
    if (terminal::readSecret("Repeat the new password") != password)
        throw Failure(BadUsage, "the passwords differ, so nothing was changed");
    return password;
}

std::string textOf(std::string const& file)
{
    errno = 0;
    std::ifstream const stream(file, std::ios::binary);
    std::ostringstream text;
    if (stream)
        text << stream.rdbuf();
    if (errno != 0)
        throw Failure(BadUsage, fmt::format("cannot read the password file '{}': {}", file,
                                            std::strerror(errno)));
    return text.str();
}

} // namespace

std::string passwordIn(std::string const& text, std::string const& file)
{
    std::vector<std::string> const lines = linesOf(text);
    if (lines.size() != 1)
        throw Failure(BadUsage, fmt::format("the password file '{}' has {} lines (put the password "
                                            "on one line)",
                                            file, lines.size()));
    return lines.front();
}

std::string readNewPassword(Session const& session, std::string const& file)
{
    if (!file.empty() && file != "-")
        return passwordIn(textOf(file), file);
    if (session.isScripted())
        throw Failure(BadUsage, "cannot read a password from standard input, which is the script "
                                "(use --password-file FILE)");
    return terminal::canAsk() ? askTwice() : terminal::readSecret("Password");
}

} // namespace mihost
