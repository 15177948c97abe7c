#ifndef TESTS_SUPPORT_SCRATCHFOLDER_H
#define TESTS_SUPPORT_SCRATCHFOLDER_H

#include <string>

/** A new empty temporary directory, which the destructor removes with all its files. */
class ScratchFolder
{
public:
    ScratchFolder();
    ~ScratchFolder();
    ScratchFolder(ScratchFolder const&) = delete;
    ScratchFolder& operator=(ScratchFolder const&) = delete;

    std::string const& name() const;

    /** @return the full path of a name in the directory */
    std::string path(std::string const& name) const;

    /**
     * Gives a file this content, keeping the same file if it exists, and makes the directories that
     * lead to it.
     *
     * @return its full path
     */
    std::string write(std::string const& name, std::string const& content) const;

    void append(std::string const& name, std::string const& content) const;

private:
    std::string folder_;
};

#endif
