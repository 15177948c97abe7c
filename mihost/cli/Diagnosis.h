#ifndef MIHOST_CLI_DIAGNOSIS_H
#define MIHOST_CLI_DIAGNOSIS_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/** One thing that a full tree needs. */
struct Need {
    std::string what;
    std::optional<std::string> problem; // nothing where all is well
    std::string cost;                   // what suffers without it
    std::string debian;                 // what mends it on Debian and its kin
    std::string redHat;                 // and on Red Hat and its kin
};

/**
 * Looks at this machine. Changes nothing on it. What can only be told of something that is missing
 * itself is left out.
 */
std::vector<Need> diagnose();

} // namespace mihost

#endif
