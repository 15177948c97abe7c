#include "mihost/cli/output/UnknownValues.h"

#include <fmt/format.h>
#include <utility>

namespace mihost
{

namespace
{

/** Why values are unknown, for the next warning. */
std::string& pendingReason()
{
    static std::string reason;
    return reason;
}

} // namespace

void noteUnknown(std::string const& reason)
{
    if (pendingReason().empty())
        pendingReason() = reason;
}

std::string takeUnknownWarning()
{
    std::string const reason = std::exchange(pendingReason(), "");
    return reason.empty() ? ""
                          : fmt::format("reading passwords and ageing: {}, so some values are "
                                        "unknown (see 'mihost doctor')",
                                        reason);
}

} // namespace mihost
