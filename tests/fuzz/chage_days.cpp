#include "sysdata/userInfo_linux.h"
#include "tests/fuzz/support/System.h"

// Output of chage, and how passwd says that an account is locked.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::string const output = fuzz::text(data, size);
    system.commands = {{"", output}};
    NQ::userInfo user;
    char command[] = "chage -l jdoe";
    char label[] = "Password expires";
    long const reference = 1273622400; // 12 May 2010
    long const days = user.getDays(command, label, reference);
    fuzz::require(days >= 0);
    if (output.find(label) == std::string::npos)
        fuzz::require(days == reference / 86400);
    user.setInactivityTimeout(output, "jdoe");
    user.setPasswordExpiration(output, "jdoe");

    char name[] = "jdoe";
    bool const says = output.find("Password locked") != std::string::npos ||
                      output.find("Locked password") != std::string::npos;
    fuzz::require(says || !user.findIsAcctDisabled(name));
    return 0;
}
