#include "mihost/cli/system/Privilege.h"

#include <memory>

namespace mihost
{

namespace
{

struct Free {
    void operator()(cap_t capabilities) const
    {
        cap_free(capabilities);
    }
};

} // namespace

bool hasCapability(cap_value_t capability)
{
    std::unique_ptr<std::remove_pointer_t<cap_t>, Free> const mine(cap_get_proc());
    cap_flag_value_t isSet = CAP_CLEAR;
    return mine && cap_get_flag(mine.get(), capability, CAP_EFFECTIVE, &isSet) == 0 &&
           isSet == CAP_SET;
}

} // namespace mihost
