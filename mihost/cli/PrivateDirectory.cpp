#include "mihost/cli/PrivateDirectory.h"

#include "mihost/cli/Failure.h"
#include "mihost/cli/Interrupts.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fmt/format.h>
#include <unistd.h>

namespace mihost
{

PrivateDirectory::PrivateDirectory()
{
    char const* const wanted = std::getenv("TMPDIR");
    std::error_code ignored;
    auto const parent = std::filesystem::absolute(wanted && *wanted ? wanted : "/tmp", ignored);
    path_ = parent / "mihost-XXXXXX";
    interrupts::Held const held; // no signal between making it and knowing of it
    if (!mkdtemp(path_.data()))
        throw Failure(NoPlugin, fmt::format("cannot make a private directory in '{}': {}",
                                            parent.string(), std::strerror(errno)));
    previous_ = Descriptor(open(".", O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (chdir(path_.c_str()) != 0) {
        int const problem = errno;
        rmdir(path_.c_str());
        throw Failure(NoPlugin, fmt::format("cannot enter the private directory '{}': {}", path_,
                                            std::strerror(problem)));
    }
    interrupts::setFolderToRemove(path_.c_str());
}

PrivateDirectory::~PrivateDirectory()
{
    // Where the way back is gone, the root serves: a directory that is stood in stays around.
    if (fchdir(previous_.get()) != 0 && chdir("/") != 0)
        std::perror("mihost: chdir");
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
    interrupts::setFolderToRemove(nullptr);
}

} // namespace mihost
