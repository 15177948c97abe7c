#ifndef MIHOST_CLI_DOCTOR_DIAGNOSIS_H
#define MIHOST_CLI_DOCTOR_DIAGNOSIS_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/** The command that fixes something on each family of systems; empty if there is none. */
struct Fix {
    std::string debian;
    std::string redHat;
    std::string opensuse;
};

/** One thing that a full tree, or a change, needs. */
struct Need {
    std::string what;
    std::optional<std::string> problem; // nothing if all is well
    std::string effect;                 // what fails without it
    Fix fix;
    std::string noFix; // why nothing on this machine fixes it; empty if it can be
};

/**
 * Inspects this machine without changing it. Properties of missing things are omitted.
 */
std::vector<Need> diagnose();

/** As diagnose, without what depends on who runs the program: privileges and the locale. */
std::vector<Need> diagnoseMachine();

} // namespace mihost

#endif
