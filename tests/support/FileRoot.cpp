#include "tests/support/FileRoot.h"

#include <grp.h>
#include <memory>

namespace
{

FILE* reallyOpen(char const* path, char const* mode)
{
    static auto* const open = interpose::real(fopen);
    return open(path, mode);
}

/** A group database of one file, read again from its start after a rewind. */
class GroupFile
{
public:
    explicit GroupFile(std::string path) : path_(std::move(path)) {}
    ~GroupFile()
    {
        close();
    }
    GroupFile(GroupFile const&) = delete;
    GroupFile& operator=(GroupFile const&) = delete;

    void rewind()
    {
        close();
        stream_ = reallyOpen(path_.c_str(), "r");
    }

    group* next()
    {
        if (!stream_)
            rewind();
        return stream_ ? fgetgrent(stream_) : nullptr;
    }

    void close()
    {
        if (stream_)
            std::fclose(stream_);
        stream_ = nullptr;
    }

private:
    std::string const path_;
    FILE* stream_ = nullptr;
};

} // namespace

FileRoot::FileRoot(std::string root)
{
    auto const groups = std::make_shared<GroupFile>(root + "/etc/group");
    libc::hooks().setgrent = [groups] { groups->rewind(); };
    libc::hooks().getgrent = [groups] { return groups->next(); };
    libc::hooks().endgrent = [groups] { groups->close(); };
    if (!libc::hooks().lckpwdf)
        libc::hooks().lckpwdf = [] { return 0; };
    if (!libc::hooks().ulckpwdf)
        libc::hooks().ulckpwdf = [] { return 0; };
    libc::hooks().fopen = [root = std::move(root)](char const* path, char const* mode) {
        std::string const asked = path;
        bool const below = asked.rfind("/etc/", 0) == 0 || asked.rfind("/var/log/", 0) == 0;
        return reallyOpen(below ? (root + asked).c_str() : path, mode);
    };
}

FileRoot::~FileRoot()
{
    libc::hooks().fopen = nullptr;
    libc::hooks().ulckpwdf = nullptr;
    libc::hooks().lckpwdf = nullptr;
    libc::hooks().endgrent = nullptr;
    libc::hooks().getgrent = nullptr;
    libc::hooks().setgrent = nullptr;
}
