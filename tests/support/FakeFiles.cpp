#include "tests/support/FakeFiles.h"

#include <filesystem>

FakeFiles::FakeFiles() : root_(folder_.name()) {}

void FakeFiles::write(std::string const& path, std::string const& text) const
{
    folder_.write(path, text);
}

void FakeFiles::remove(std::string const& path) const
{
    std::filesystem::remove(realPath(path));
}

std::string FakeFiles::realPath(std::string const& path) const
{
    return folder_.name() + path;
}
