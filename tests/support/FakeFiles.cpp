#include "tests/support/FakeFiles.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace
{

std::string newFolder()
{
    std::string name = std::filesystem::temp_directory_path() / "mi-files-XXXXXX";
    return mkdtemp(name.data());
}

} // namespace

FakeFiles::FakeFiles() : folder_(newFolder()), root_(folder_) {}

FakeFiles::~FakeFiles()
{
    std::filesystem::remove_all(folder_);
}

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
    return folder_ + path;
}
