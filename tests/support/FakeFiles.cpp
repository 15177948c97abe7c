#include "tests/support/FakeFiles.h"

#include <filesystem>
#include <fstream>

FakeFiles::FakeFiles() : root_(folder_.name()) {}

void FakeFiles::write(std::string const& path, std::string const& text) const
{
    std::filesystem::path const real = realPath(path);
    std::filesystem::create_directories(real.parent_path());
    std::ofstream(real, std::ios::binary) << text;
}

void FakeFiles::remove(std::string const& path) const
{
    std::filesystem::remove(realPath(path));
}

std::string FakeFiles::realPath(std::string const& path) const
{
    return folder_.name() + path;
}
