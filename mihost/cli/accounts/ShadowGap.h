#ifndef MIHOST_CLI_ACCOUNTS_SHADOWGAP_H
#define MIHOST_CLI_ACCOUNTS_SHADOWGAP_H

#include "host/MutableNode.h"

#include <string>

namespace mihost
{

/**
 * Whether the plug-in found a user's entry in /etc/shadow, and why not. If not, the values from
 * there are zero or empty, not the real ones.
 */
class ShadowGap
{
public:
    /** Any node; only users have something from there. */
    explicit ShadowGap(IC::MutableNode const& node);

    /** Why this value is unknown; empty if it is not. */
    std::string reasonFor(unsigned int property, IC::PropertyValue const& value) const;

private:
    std::string reason_; // empty for no gap
};

} // namespace mihost

#endif
