#ifndef MIHOST_RUNTIME_OUTCOME_H
#define MIHOST_RUNTIME_OUTCOME_H

#include "host/Error.h"

/** What the runtime's operations return. */
namespace mihost
{

[[gnu::visibility("hidden")]] inline IC::Error success()
{
    return {0, IC::Number(IC::Number::EmptyKind), ""};
}

[[gnu::visibility("hidden")]] inline IC::Error failure(std::string const& reason)
{
    return {1, IC::Number(IC::Number::EmptyKind), reason};
}

} // namespace mihost

#endif
