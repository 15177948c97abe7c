#ifndef MIHOST_CLI_DOCTOR_DIAGNOSIS_H
#define MIHOST_CLI_DOCTOR_DIAGNOSIS_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/** One thing that a full tree, or a change, needs. */
struct Need {
    std::string what;
    std::optional<std::string> problem; // nothing if all is well
    std::string effect;                 // what suffers without it
    std::string debian;                 // the fix on Debian and similar systems; empty for none
    std::string redHat;                 // and on Red Hat and similar systems
    std::string noFix;                  // why nothing on this machine fixes it; empty if it can be
};

/**
 * Inspects this machine without changing it. Properties of missing things are omitted.
 */
std::vector<Need> diagnose();

/** As diagnose, without what depends on who runs the program: privileges and the locale. */
std::vector<Need> diagnoseMachine();

} // namespace mihost

#endif
