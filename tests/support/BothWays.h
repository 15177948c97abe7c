#ifndef TESTS_SUPPORT_BOTHWAYS_H
#define TESTS_SUPPORT_BOTHWAYS_H

#include "mihost/accel/Accel.h"
#include "mihost/accel/Stream.h"
#include "tests/interpose/Libc.h"

#include <array>
#include <cstdio>
#include <ctime>
#include <optional>
#include <string>
#include <utility>

/** Runs a command and asks the accelerator, to compare both. For programs that contain it. */
namespace bothways
{

inline std::string readAll(FILE* stream)
{
    std::string text;
    std::array<char, 65536> block;
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        text.append(block.data(), length);
    return text;
}

/** @return what the command prints in a real shell, standard output and standard error */
inline std::string real(std::string const& command)
{
    FILE* const stream = interpose::real(popen)(("{ " + command + "; } 2>&1").c_str(), "r");
    std::string text = readAll(stream);
    interpose::real(pclose)(stream);
    return text;
}

/** @return the accelerator's answer; nothing if it leaves the command to the real popen */
inline std::optional<std::string> answered(std::string const& command)
{
    FILE* const stream = miaccel::openAnswer(command.c_str(), "r");
    if (!stream)
        return std::nullopt;
    std::string text = readAll(stream);
    std::fclose(stream);
    return text;
}

inline std::time_t secondOf(clockid_t clock)
{
    timespec now{};
    clock_gettime(clock, &now);
    return now.tv_sec;
}

/** @return what date prints and the accelerator's answer to it, both of the same second */
inline std::pair<std::string, std::optional<std::string>> dates()
{
    for (;;) {
        // Some dates take the time from this clock, which is late by up to a tick.
        std::time_t const begun = secondOf(CLOCK_REALTIME_COARSE);
        std::pair both{real("date"), answered("date")};
        if (begun == secondOf(CLOCK_REALTIME))
            return both;
    }
}

/** @return the counts of one command */
inline miaccel_count countOf(std::string const& command)
{
    std::array<miaccel_count, 16> counts{};
    miaccel_counts(counts.data(), counts.size());
    for (miaccel_count const& count : counts)
        if (count.command && command == count.command)
            return count;
    return {};
}

/** @return why the command was last run rather than answered */
inline std::string reasonOf(std::string const& command)
{
    char const* const reason = countOf(command).reason;
    return reason ? reason : "";
}

} // namespace bothways

#endif
