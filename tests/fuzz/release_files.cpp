#include "sysdata/osInfo_linux.h"
#include "tests/fuzz/support/System.h"

#include <algorithm>

// One text serves as every release file and as every command's output.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::string const text = fuzz::text(data, size);
    system.files = {{"/etc/release", text}, {"/etc/redhat-release", text}};
    system.commands = {{"", text}};
    NQ::OsInfo info;
    std::string name;
    std::string version;
    long date = 0;
    fuzz::require(info.getOSName(name) && name.size() <= std::max<std::size_t>(size, 5));
    fuzz::require(info.getInstallDate(date));
    if (!info.getKestoVersion("/etc/release", version))
        fuzz::require(!info.getOSVersion(version) || version.size() <= 9);
    return 0;
}
