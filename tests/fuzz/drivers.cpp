#include "sysdata/driverInfo_linux.h"
#include "tests/fuzz/support/System.h"

#include <algorithm>

// Output of lsmod, then of modinfo.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::vector<std::string> const outputs = fuzz::sections(data, size, 2);
    system.commands = {{"lsmod", outputs[0]}, {"modinfo ", outputs[1]}};
    std::vector<NQ::driverInfo> drivers;
    NQ::getDriverInfo(drivers);
    auto const pieces = std::count(outputs[0].begin(), outputs[0].end(), '\n') +
                        static_cast<std::ptrdiff_t>(outputs[0].size()) / 511 + 1;
    fuzz::require(static_cast<std::ptrdiff_t>(drivers.size()) <= pieces);
    return 0;
}
