#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace
{

std::string freshFolder()
{
    std::string name = std::filesystem::temp_directory_path() / "mi-scratch-XXXXXX";
    return mkdtemp(name.data());
}

} // namespace

ScratchFolder::ScratchFolder() : folder_(freshFolder()) {}

ScratchFolder::~ScratchFolder()
{
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
}

std::string const& ScratchFolder::name() const
{
    return folder_;
}

std::string ScratchFolder::path(std::string const& name) const
{
    return folder_ + '/' + name;
}

std::string ScratchFolder::write(std::string const& name, std::string const& content) const
{
    std::string const file = path(name);
    std::filesystem::create_directories(std::filesystem::path(file).parent_path());
    std::ofstream(file, std::ios::binary | std::ios::trunc) << content;
    return file;
}

void ScratchFolder::append(std::string const& name, std::string const& content) const
{
    std::ofstream(path(name), std::ios::binary | std::ios::app) << content;
}
