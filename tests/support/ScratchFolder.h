#ifndef TESTS_SUPPORT_SCRATCHFOLDER_H
#define TESTS_SUPPORT_SCRATCHFOLDER_H

#include <string>

/** An empty folder below the temporary one, which goes with all that is in it. */
class ScratchFolder
{
public:
    ScratchFolder();
    ~ScratchFolder();
    ScratchFolder(ScratchFolder const&) = delete;
    ScratchFolder& operator=(ScratchFolder const&) = delete;

    std::string const& name() const;

    /** The full path of a name in it. */
    std::string path(std::string const& name) const;

    /**
     * Gives a file this content, keeping the file where there is one, and makes the folders that
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
