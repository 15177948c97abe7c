#include "sysdata/osInfo_log.h"

#include "host/Methods.h"
#include "sysdata/osInfo_commands.h"

#include <algorithm>

namespace NQ::os
{

std::string withoutPasswords(std::string const& output, std::vector<ParamInfo> const& params)
{
    std::vector<std::string> hidden;
    for (ParamInfo const& param : params)
        if (param.name == IC::parameter::password && !param.value.empty())
            hidden.insert(hidden.end(), {param.value, withEscapedBlanks(param.value)});
    // The longest first: else a password that begins another would leave the rest of it visible.
    std::sort(hidden.begin(), hidden.end(), [](std::string const& one, std::string const& other) {
        return one.size() > other.size();
    });
    std::string shown;
    for (std::string::size_type at = 0; at < output.size();) {
        auto const found =
            std::find_if(hidden.begin(), hidden.end(), [&](std::string const& password) {
                return output.compare(at, password.size(), password) == 0;
            });
        if (found == hidden.end()) {
            shown += output[at++];
        } else {
            shown += "(hidden)";
            at += found->size();
        }
    }
    return shown;
}

} // namespace NQ::os
