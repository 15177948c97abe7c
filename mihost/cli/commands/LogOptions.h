#ifndef MIHOST_CLI_COMMANDS_LOGOPTIONS_H
#define MIHOST_CLI_COMMANDS_LOGOPTIONS_H

#include "host/MutableNode.h"
#include "mihost/cli/input/Options.h"
#include "mihost/cli/log/LogFilter.h"
#include "mihost/cli/output/NodeView.h"

#include <CLI/App.hpp>
#include <optional>
#include <string>
#include <vector>

namespace mihost
{

class Session;

/** What "list log" has in addition to the other lists. */
class LogOptions
{
public:
    void declare(CLI::App& app);

    /** The first of the options that was given, such as "--since"; empty for none. */
    std::string firstGiven() const;

    /** Adopts the options of all commands. @throws Failure (BadUsage) if some conflict */
    void check(Options const& options);

    bool follows() const
    {
        return follow_;
    }

    /** The log entries that are shown, newest first. */
    std::vector<IC::MutableNode*> chosen(std::vector<IC::MutableNode*> const& entries) const;

    /** A property of a log entry as it is shown. */
    std::string shownText(PropertyView const& property) const;

    /** Prints the newest lines of the log and then each new one, until Ctrl-C. @throws Failure */
    void follow(Session& session) const;

private:
    LogFilter filter() const;
    std::string shownMessage(std::string const& message) const;
    void print(Session& session, LogLine const& line) const;

    std::optional<unsigned int> count_;
    std::string since_;
    std::string until_;
    std::string pattern_;
    bool follow_ = false;
    bool noHostName_ = false;
    bool isFull_ = false;
};

} // namespace mihost

#endif
