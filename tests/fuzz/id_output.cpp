#include "sysdata/osInfo_members.h"
#include "tests/fuzz/support/System.h"

// What id prints.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    std::string const identity = fuzz::text(data, size);
    std::string const group = "\"staff\"";
    std::string const added = NQ::os::supplementaryGroups(identity, group, NQ::os::Membership::add);
    fuzz::require(added.size() >= group.size() &&
                  added.compare(added.size() - group.size(), group.size(), group) == 0);

    std::string const left =
        NQ::os::supplementaryGroups(identity, group, NQ::os::Membership::remove);
    fuzz::require(left.empty() || identity.find('(') != std::string::npos);
    // A name that contains a quote may look like another name.
    fuzz::require(identity.find('"') != std::string::npos ||
                  ("," + left + ",").find("," + group + ",") == std::string::npos);
    return 0;
}
