#ifndef MIHOST_CLI_LOG_LOGLINE_H
#define MIHOST_CLI_LOG_LOGLINE_H

#include <ctime>
#include <optional>
#include <string>
#include <string_view>

namespace mihost
{

constexpr char systemLog[] = "/var/log/messages";

/** The most log entries that the plug-in's tree has. */
constexpr unsigned int mostLogEntries = 50;

/** A line of the system log as the plug-in shows it. */
struct LogLine {
    std::optional<long> time; // nothing if the line does not begin with a stamp
    std::string message;      // without the stamp and without the plug-in's asterisks
};

/**
 * @param line   without its end
 * @param today  the local time, since a stamp has no year
 */
LogLine logLineOf(std::string_view line, std::tm const& today);

/** Whether the line begins with a complete time stamp, such as "Jan  2 03:04:05 ". */
bool hasStamp(std::string_view line);

/** The message without the asterisks that the plug-in puts around it. */
std::string withoutAsterisks(std::string const& message);

/** The message without its first word, which names the host. */
std::string withoutHostName(std::string const& message);

} // namespace mihost

#endif
