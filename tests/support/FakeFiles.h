#ifndef TESTS_SUPPORT_FAKEFILES_H
#define TESTS_SUPPORT_FAKEFILES_H

#include "tests/support/FileRoot.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <string>

/**
 * While it exists, /etc and /var/log contain only the files written here.
 *
 * The files are in their own directory, which the destructor removes.
 */
class FakeFiles
{
public:
    FakeFiles() : root_(folder_.name()) {}

    /** @param path  as the plug-in names it, such as "/etc/passwd" */
    void write(std::string const& path, std::string const& text) const
    {
        folder_.write(path, text);
    }

    void remove(std::string const& path) const
    {
        std::filesystem::remove(realPath(path));
    }

    /** @return where the file really is */
    std::string realPath(std::string const& path) const
    {
        return folder_.name() + path;
    }

private:
    ScratchFolder folder_;
    FileRoot root_;
};

#endif
