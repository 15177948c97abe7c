#ifndef TESTS_SUPPORT_FAKEFILES_H
#define TESTS_SUPPORT_FAKEFILES_H

#include "tests/support/FileRoot.h"
#include "tests/support/ScratchFolder.h"

#include <string>

/**
 * While it exists, /etc and /var/log contain only the files written here.
 *
 * The files are in their own directory, which the destructor removes.
 */
class FakeFiles
{
public:
    FakeFiles();
    ~FakeFiles() = default;
    FakeFiles(FakeFiles const&) = delete;
    FakeFiles& operator=(FakeFiles const&) = delete;

    /** @param path  as the plug-in names it, such as "/etc/passwd" */
    void write(std::string const& path, std::string const& text) const;

    void remove(std::string const& path) const;

    /** @return where the file really is */
    std::string realPath(std::string const& path) const;

private:
    ScratchFolder folder_;
    FileRoot root_;
};

#endif
