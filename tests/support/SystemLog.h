#ifndef TESTS_SUPPORT_SYSTEMLOG_H
#define TESTS_SUPPORT_SYSTEMLOG_H

#include <cstdio>
#include <map>
#include <string>
#include <vector>

/** The system's log: lines to fill it with, and the commands that read it. */
namespace systemLog
{

constexpr char path[] = "/var/log/messages";

/** The command that counts its lines. */
constexpr char count[] = "wc -l /var/log/messages";

/** The command that prints one line, counted from 1. */
inline std::string line(unsigned int number)
{
    return "sed -n '" + std::to_string(number) + "p' " + path;
}

/** "Nov 20 10:11:SS message N" for each N from 1, SS being N modulo 60. */
inline std::vector<std::string> messages(unsigned int number)
{
    std::vector<std::string> lines;
    for (unsigned int n = 1; n <= number; ++n) {
        char stamp[32];
        std::snprintf(stamp, sizeof stamp, "Nov 20 10:11:%02u ", n % 60);
        lines.push_back(std::string(stamp) + "message " + std::to_string(n));
    }
    return lines;
}

/** What the commands, and date, print if the log has these lines. */
inline std::map<std::string, std::string> answers(std::vector<std::string> const& lines)
{
    std::map<std::string, std::string> found = {
        {count, std::to_string(lines.size()) + " " + path + "\n"},
        {"date", "Sat Nov 21 03:15:30 UTC 2026\n"}};
    for (unsigned int n = 1; n <= lines.size(); ++n)
        found[line(n)] = lines[n - 1] + "\n";
    return found;
}

} // namespace systemLog

#endif
