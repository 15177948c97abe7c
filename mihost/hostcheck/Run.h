#ifndef MIHOST_HOSTCHECK_RUN_H
#define MIHOST_HOSTCHECK_RUN_H

#include "mihost/hostcheck/Check.h"
#include "mihost/hostcheck/Tap.h"

#include <string>
#include <vector>

namespace hostcheck
{

struct Finding {
    std::string name;
    std::string explanation; // empty for a promise that is kept
};

/** All checks of one host, in two stages. */
class Run
{
public:
    Run();

    /**
     * Checks what everything else needs: layouts, virtual operations, type information. Stops at
     * the first failure, since calls of such a host would reach wrong functions.
     */
    bool checkGround();

    void checkOperations();

    std::vector<Finding> const& findings() const
    {
        return findings_;
    }

    /** "90 checks passed", or how many failed and which was the first. */
    std::string summary() const;

    bool failed() const;

    /** Empty unless the requested TAP file cannot be written. */
    std::string tapProblem() const;

private:
    /** Returns whether the promise is kept. */
    bool check(Check const& row);

    Checks const ground_;
    Checks const operations_;
    Tap tap_;
    std::vector<Finding> findings_;
};

} // namespace hostcheck

#endif
