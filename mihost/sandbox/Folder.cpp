#include "mihost/sandbox/Folder.h"

#include "mihost/sandbox/SystemCall.h"

#include <dirent.h>
#include <fcntl.h>
#include <memory>

namespace mihost
{

namespace
{

struct CloseFolder {
    void operator()(DIR* folder) const
    {
        closedir(folder);
    }
};

} // namespace

std::vector<std::string> namesIn(Descriptor const& folder, std::string const& path)
{
    Descriptor copy(check(openat(folder.get(), ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC),
                          "cannot read " + path));
    std::unique_ptr<DIR, CloseFolder> const entries(fdopendir(copy.get()));
    if (!entries)
        failed("cannot read " + path);
    copy.release();
    std::vector<std::string> names;
    while (dirent const* entry = readdir(entries.get())) {
        std::string const name = entry->d_name;
        if (name != "." && name != "..")
            names.push_back(name);
    }
    return names;
}

} // namespace mihost
