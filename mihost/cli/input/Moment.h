#ifndef MIHOST_CLI_INPUT_MOMENT_H
#define MIHOST_CLI_INPUT_MOMENT_H

#include <optional>
#include <string>

namespace mihost
{

constexpr char momentForm[] = "YYYY-MM-DD, \"YYYY-MM-DD HH:MM:SS\", now, today, yesterday or "
                              "\"N minutes ago\" (seconds, minutes, hours, days, weeks)";

/** Seconds since 1970 of a point in local time, written in one of these forms. */
std::optional<long> parseMoment(std::string const& text, long now);

} // namespace mihost

#endif
