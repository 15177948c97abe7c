#include "sysdata/minMaxId.h"
#include "tests/fuzz/support/System.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    system.files["/etc/login.defs"] = fuzz::text(data, size);
    NQ::minMaxId range;
    bool const named = system.files["/etc/login.defs"].find("UID_MIN") != std::string::npos;
    fuzz::require(named || range.getMinUserId() == 0);
    return 0;
}
