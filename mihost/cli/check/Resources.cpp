#include "mihost/cli/check/Resources.h"

#include <filesystem>
#include <iterator>
#include <malloc.h>
#include <string>
#include <sys/wait.h>

namespace mihost::checks
{

namespace
{

std::size_t entriesOf(std::string const& folder)
{
    auto const listing = std::filesystem::directory_iterator(folder);
    return static_cast<std::size_t>(std::distance(begin(listing), end(listing)));
}

bool hasChildren()
{
    siginfo_t info{};
    return waitid(P_ALL, 0, &info, WEXITED | WNOHANG | WNOWAIT) == 0;
}

std::size_t heap()
{
    auto const info = mallinfo2();
    return info.uordblks + info.hblkhd;
}

} // namespace

Resources resourcesInUse()
{
    return {entriesOf("/proc/self/fd"), entriesOf("/proc/self/task"), heap(), hasChildren()};
}

} // namespace mihost::checks
