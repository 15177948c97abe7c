#ifndef MIHOST_ACCEL_ANSWERS_H
#define MIHOST_ACCEL_ANSWERS_H

#include <cstdint>
#include <ctime>
#include <optional>
#include <string>

namespace miaccel
{

/** Why a command was run rather than answered, a text that is never freed; null if it was not. */
using Reason = char const*;

/** What a command prints. Without a text, the command is left to the real popen. */
struct Answer {
    std::optional<std::string> text;
    Reason reason = nullptr; // with a text: it is what the command has just printed
};

inline Answer declined(Reason reason)
{
    return {std::nullopt, reason};
}

/** The operands of a command line. */
struct Operands {
    std::string name; // of a file or a module
    std::uint64_t line = 0;
};

/** wc -l FILE */
Answer wc(Operands const& operands);

/** sed -n 'LINEp' FILE. The line is held in memory, up to 16 MiB. */
Answer sed(Operands const& operands);

/**
 * date. Versions of date treat locales differently, so the real one runs first, and again in each
 * new hour or environment, and its output is compared with the answer. Within an hour only the
 * digits of minutes and seconds change, which all versions print the same.
 */
Answer date(Operands const&);

/** What date prints at the given time in the environment's locale and zone; empty if unknown. */
std::string dateAt(std::time_t now);

/** lsmod */
Answer lsmod(Operands const&);

/** modinfo MODULE */
Answer modinfo(Operands const& operands);

} // namespace miaccel

#endif
