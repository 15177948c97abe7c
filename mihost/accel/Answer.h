#ifndef MIHOST_ACCEL_ANSWER_H
#define MIHOST_ACCEL_ANSWER_H

#include <string>
#include <utility>

namespace miaccel
{

/** Why a command is left to the real popen; a text that lives for good. Null: it is not. */
using Reason = char const*;

/** What a command prints, or why it is left to the real popen. */
struct Answer {
    static Answer with(std::string text)
    {
        return {std::move(text), nullptr};
    }
    static Answer none(Reason reason)
    {
        return {{}, reason};
    }

    std::string text;
    Reason declined;
};

} // namespace miaccel

#endif
