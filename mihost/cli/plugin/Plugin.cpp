#include "mihost/cli/plugin/Plugin.h"

#include "host/OpenMI.h"
#include "mihost/cli/system/Failure.h"

#include <dlfcn.h>
#include <filesystem>
#include <fmt/format.h>
#include <link.h>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr char plainName[] = "libzorvvxicosswmi.so.1";
constexpr unsigned int ownMiId = 1;

/** @return the loader's last message, without the file's name before it */
std::string loaderReason(std::string const& file)
{
    char const* const said = dlerror();
    std::string reason = said ? said : "unknown reason";
    std::string const prefix = file + ": ";
    if (reason.compare(0, prefix.size(), prefix) == 0)
        reason.erase(0, prefix.size());
    return reason;
}

Failure cannotLoad(std::string const& file, std::string const& reason)
{
    return {NoPlugin, fmt::format("cannot load the plug-in '{}': {}", file, reason)};
}

link_map const* linkMap(void* library)
{
    link_map* map = nullptr;
    return dlinfo(library, RTLD_DI_LINKMAP, &map) == 0 ? map : nullptr;
}

} // namespace

std::string pluginFile(std::string const& named)
{
    std::error_code problem;
    if (!named.empty()) {
        // Read before the working directory changes; and a name without a slash is a file as well.
        auto const path = std::filesystem::absolute(named, problem);
        return problem ? named : path.string();
    }
    auto const self = std::filesystem::read_symlink("/proc/self/exe", problem);
    auto const beside = (self.parent_path() / "../lib" / plainName).lexically_normal();
    return access(beside.c_str(), F_OK) == 0 ? beside.string() : plainName;
}

Plugin::Plugin(std::string const& file) : library_(dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL))
{
    if (!library_)
        throw cannotLoad(file, loaderReason(file));
    auto const open = reinterpret_cast<decltype(&OpenMI)>(dlsym(library_, "OpenMI"));
    std::string reason;
    if (!open)
        reason = "it has no entry point OpenMI";
    else if (int const answer = open(&interface_, &status_); answer != 0)
        reason = fmt::format("OpenMI returned {}", answer);
    else if (!interface_)
        reason = "OpenMI returned no interface";
    if (reason.empty())
        return;
    dlclose(library_);
    throw cannotLoad(file, reason);
}

Plugin::~Plugin()
{
    if (started_)
        interface_->unload();
    dlclose(library_);
}

void Plugin::start()
{
    IC::Error const error = interface_->initialize(ownMiId, IC::Number(0U), IC::Number(0U));
    started_ = true;
    if (error.getStatus() != 0)
        throw Failure(
            Failed, fmt::format("the plug-in did not start: {}", static_cast<std::string>(error)));
}

std::string Plugin::path() const
{
    link_map const* const map = linkMap(library_);
    return map ? map->l_name : "";
}

std::string Plugin::soname() const
{
    link_map const* const map = linkMap(library_);
    if (!map)
        return "";
    char const* strings = nullptr;
    std::size_t offset = 0;
    for (ElfW(Dyn) const* entry = map->l_ld; entry->d_tag != DT_NULL; ++entry) {
        if (entry->d_tag == DT_STRTAB)
            // NOLINTNEXTLINE(performance-no-int-to-ptr): the loader keeps addresses as numbers
            strings = reinterpret_cast<char const*>(entry->d_un.d_ptr);
        else if (entry->d_tag == DT_SONAME)
            offset = entry->d_un.d_val;
    }
    return strings && offset != 0 ? strings + offset : "";
}

} // namespace mihost
