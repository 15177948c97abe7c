#include "mihost/accel/Accelerator.h"

#include "mihost/accel/Accel.h"
#include "mihost/accel/Command.h"
#include "mihost/accel/Date.h"
#include "mihost/accel/Modules.h"
#include "mihost/accel/Resolve.h"
#include "mihost/accel/Sed.h"
#include "mihost/accel/Stream.h"
#include "mihost/accel/Wc.h"

#include <algorithm>
#include <atomic>
#include <exception>
#include <optional>
#include <string_view>

namespace miaccel
{

namespace
{

std::atomic<bool> enabled{true};

struct Count {
    char const* command;
    std::atomic<unsigned long> answered{0};
    std::atomic<unsigned long> handedOn{0};
    std::atomic<Reason> reason{nullptr};
};

/** In the order of Kind; the last one is for everything else. */
Count counts[] = {{"wc"}, {"sed"}, {"date"}, {"lsmod"}, {"modinfo"}, {"other"}};

Count& countOf(std::optional<Command> const& command)
{
    return command ? counts[static_cast<std::size_t>(command->kind)] : *std::prev(std::end(counts));
}

Answer ask(Command const& command)
{
    switch (command.kind) {
    case Kind::Wc:
        return wc(command.name);
    case Kind::Sed:
        return sed(command.name, command.line);
    case Kind::Date:
        return date();
    case Kind::Lsmod:
    case Kind::Modinfo:
        if (Reason const reason = strangeLibrary())
            return Answer::none(reason);
        return command.kind == Kind::Lsmod ? lsmod() : modinfo(command.name);
    }
    return Answer::none("not known here");
}

Answer answer(std::optional<Command> const& command)
{
    if (!command)
        return Answer::none("not one of the commands that are answered here");
    if (Reason const reason = unsure(command->kind))
        return Answer::none(reason);
    return ask(*command);
}

bool isPlainRead(std::string_view mode)
{
    return mode == "r" || mode == "re";
}

} // namespace

FILE* openAnswer(char const* line, char const* mode) noexcept
try {
    if (!enabled)
        return nullptr;
    std::optional<Command> const command = isPlainRead(mode) ? recognise(line) : std::nullopt;
    Count& count = countOf(command);
    Answer found = answer(command);
    FILE* const stream = found.declined ? nullptr : openStream(std::move(found.text));
    if (stream) {
        ++count.answered;
    } else {
        ++count.handedOn;
        count.reason = found.declined ? found.declined : "no stream could be made";
    }
    return stream;
} catch (std::exception const&) {
    return nullptr;
}

} // namespace miaccel

using miaccel::counts;

extern "C" int miaccel_enable(int on)
{
    return miaccel::enabled.exchange(on != 0) ? 1 : 0;
}

extern "C" std::size_t miaccel_counts(miaccel_count* rows, std::size_t room)
{
    std::size_t const count = std::size(counts);
    std::transform(counts, counts + std::min(count, room), rows, [](miaccel::Count const& from) {
        return miaccel_count{from.command, from.answered, from.handedOn, from.reason};
    });
    return count;
}
