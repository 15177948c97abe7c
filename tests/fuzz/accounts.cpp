#include "sysdata/userInfo_linux.h"
#include "tests/fuzz/support/System.h"

#include <algorithm>

// The account file, the shadow file and the login service's rules.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::vector<std::string> const texts = fuzz::sections(data, size, 3);
    system.files = {{"/etc/login.defs", "UID_MIN 0\nUID_MAX 4294967295\n"},
                    {"/etc/passwd", texts[0]},
                    {"/etc/shadow", texts[1]},
                    {"/etc/pam.d/login", texts[2]}};
    std::vector<NQ::userInfo> users(1);
    NQ::getUserInfo(users);
    auto const lines = std::count(texts[0].begin(), texts[0].end(), '\n') + 1;
    fuzz::require(static_cast<std::ptrdiff_t>(users.size()) <= lines);
    for (NQ::userInfo& user : users) {
        std::string const id = user.getUserId();
        fuzz::require(!id.empty() && id.find_first_not_of("0123456789") == std::string::npos);
        fuzz::require(user.getPwdMinDays() != NQ::USER_INFO::never);
    }
    return 0;
}
