#include "mihost/sandbox/MountTable.h"

#include <libmount.h>
#include <memory>
#include <new>
#include <set>
#include <stdexcept>

namespace mihost
{

namespace
{

using Table = std::unique_ptr<libmnt_table, decltype(&mnt_unref_table)>;
using Iterator = std::unique_ptr<libmnt_iter, decltype(&mnt_free_iter)>;

template <class Type> Type* required(Type* made)
{
    if (!made)
        throw std::bad_alloc();
    return made;
}

/** Lines that cannot be parsed are skipped. */
int skipLine(libmnt_table*, char const*, int)
{
    return 1;
}

Table parse(std::string const& file)
{
    Table table(required(mnt_new_table()), mnt_unref_table);
    mnt_table_set_parser_errcb(table.get(), skipLine);
    if (mnt_table_parse_file(table.get(), file.c_str()) != 0)
        throw std::runtime_error("cannot read the table of mounts in " + file);
    return table;
}

bool isAtOrBelow(std::string const& path, std::string const& folder)
{
    return path.rfind(folder, 0) == 0 &&
           (path.size() == folder.size() || path[folder.size()] == '/');
}

bool hasItsOwnInTheCopy(std::string const& path)
{
    for (char const* folder : {"/proc", "/sys", "/dev", "/run"})
        if (isAtOrBelow(path, folder))
            return true;
    return path == "/";
}

bool isKernelsOwn(std::string const& type)
{
    // Reading an autofs would mount file systems on the real machine.
    static std::set<std::string> const types = {
        "autofs", "binfmt_misc", "bpf",        "cgroup",    "cgroup2", "configfs", "debugfs",
        "devpts", "efivarfs",    "fusectl",    "hugetlbfs", "mqueue",  "proc",     "rpc_pipefs",
        "pstore", "nsfs",        "securityfs", "sysfs",     "tracefs"};
    return types.count(type) != 0;
}

} // namespace

std::vector<std::string> mountsToCopy(std::string const& file)
{
    Table const table = parse(file);
    Iterator const iterator(required(mnt_new_iter(MNT_ITER_FORWARD)), mnt_free_iter);
    std::set<std::string> paths;
    libmnt_fs* mount = nullptr;
    while (mnt_table_next_fs(table.get(), iterator.get(), &mount) == 0) {
        std::string const path = mnt_fs_get_target(mount);
        if (!hasItsOwnInTheCopy(path) && !isKernelsOwn(mnt_fs_get_fstype(mount)))
            paths.insert(path);
    }
    return {paths.begin(), paths.end()};
}

} // namespace mihost
