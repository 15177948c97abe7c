#ifndef MIHOST_ACCEL_COMMAND_H
#define MIHOST_ACCEL_COMMAND_H

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace miaccel
{

/** The commands known here, by the order in which they are counted. */
enum class Kind { Wc, Sed, Date, Lsmod, Modinfo };

/** A command line taken apart. */
struct Command {
    Kind kind;
    std::string name;       // a file, or a module; empty where the command takes none
    std::uint64_t line = 0; // of sed
};

/**
 * Recognises the command lines that are answered here. Nothing that a shell would expand,
 * redirect or read in any other way than as plain words, bare or in single quotes, is recognised.
 */
std::optional<Command> recognise(std::string_view line);

} // namespace miaccel

#endif
