#include "tests/fuzz/support/System.h"

#include "tests/interpose/Libc.h"

#include <cstdio>
#include <cstdlib>
#include <set>
#include <sys/mman.h>
#include <unistd.h>

namespace fuzz
{

namespace
{

std::set<FILE*> open;

FILE* streamOf(std::string const& text)
{
    int const descriptor = memfd_create("input", MFD_CLOEXEC);
    require(write(descriptor, text.data(), text.size()) == static_cast<ssize_t>(text.size()));
    lseek(descriptor, 0, SEEK_SET);
    return *open.insert(fdopen(descriptor, "r")).first;
}

/** @return whether the plug-in opens the file; the fuzzer itself opens others */
bool isMachines(std::string const& path)
{
    return path.rfind("/etc/", 0) == 0 || path.rfind("/var/log/", 0) == 0;
}

} // namespace

System::System()
{
    libc::Hooks& hooks = libc::hooks();
    hooks.popen = [this](char const* command, char const*) { return start(command); };
    hooks.pclose = [](FILE* stream) { return fclose(stream); };
    hooks.fclose = [](FILE* stream) {
        open.erase(stream);
        return libc::hooks().fclose.real()(stream);
    };
    hooks.fopen = [this](char const* path, char const* mode) {
        return isMachines(path) ? openFile(path) : libc::hooks().fopen.real()(path, mode);
    };
    hooks.lckpwdf = [] { return 0; };
    hooks.ulckpwdf = [] { return 0; };
}

System::~System()
{
    while (!open.empty())
        fclose(*open.begin());
    interpose::resetAll();
}

FILE* System::openFile(std::string const& path) const
{
    auto const file = files.find(path);
    return file == files.end() ? nullptr : streamOf(file->second);
}

FILE* System::start(std::string const& command) const
{
    for (auto const& [beginning, output] : commands)
        if (command.compare(0, beginning.size(), beginning) == 0)
            return streamOf(output);
    return nullptr;
}

std::string text(std::uint8_t const* data, std::size_t size)
{
    return std::string(data, data + size);
}

std::vector<std::string> sections(std::uint8_t const* data, std::size_t size, std::size_t count)
{
    std::string const mark = "%%\n";
    std::string rest = text(data, size);
    std::vector<std::string> found;
    while (found.size() + 1 < count) {
        std::string::size_type const end = rest.find(mark);
        found.push_back(rest.substr(0, end));
        rest = end == std::string::npos ? "" : rest.substr(end + mark.size());
    }
    found.push_back(rest);
    return found;
}

void require(bool holds)
{
    if (!holds)
        std::abort();
}

} // namespace fuzz
