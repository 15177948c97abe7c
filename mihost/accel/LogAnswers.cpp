#include "mihost/accel/Answers.h"
#include "mihost/accel/LineIndex.h"
#include "mihost/sandbox/Descriptor.h"

#include <algorithm>
#include <fcntl.h>
#include <linux/magic.h>
#include <mutex>
#include <sys/vfs.h>

namespace miaccel
{

namespace
{

constexpr std::uint64_t longestLine = 16'777'216;
constexpr Reason unsteady = "the file changes while it is read";

/**
 * File systems of other machines or programs, which may change files without a new time; those with
 * times in whole seconds; those that generate the contents of a file when it is read.
 */
constexpr unsigned int declinedFileSystems[] = {
    NFS_SUPER_MAGIC,   SMB_SUPER_MAGIC,   CIFS_SUPER_MAGIC,
    SMB2_SUPER_MAGIC,  AFS_SUPER_MAGIC,   AFS_FS_MAGIC,
    CODA_SUPER_MAGIC,  NCP_SUPER_MAGIC,   CEPH_SUPER_MAGIC,
    V9FS_MAGIC,        OCFS2_SUPER_MAGIC, FUSE_SUPER_MAGIC,
    0x01161970,        0x0BD00BD0,        0x47504653, // GFS2, Lustre, GPFS
    MSDOS_SUPER_MAGIC, 0x2011BAB0,        /* exFAT */ PROC_SUPER_MAGIC};

Reason doubt(int file, struct stat& state)
{
    struct statfs system {
    };
    if (file < 0 || fstat(file, &state) != 0 || fstatfs(file, &system) != 0)
        return "the file cannot be read";
    if (!S_ISREG(state.st_mode))
        return "the file is not a regular file";
    if (std::count(std::begin(declinedFileSystems), std::end(declinedFileSystems),
                   static_cast<unsigned int>(system.f_type)) != 0)
        return "the file system may not give each change a new time stamp";
    return nullptr;
}

Answer countText(int, LineIndex const& index, Operands const& operands)
{
    return {std::to_string(index.lineEnds()) + ' ' + operands.name + '\n'};
}

Answer lineText(int file, LineIndex const& index, Operands const& operands)
{
    std::uint64_t const line = operands.line;
    // busybox ends a line at a NUL byte, and adds a missing line end to the last line.
    if (index.hasNul())
        return declined("the file has NUL bytes, which versions of sed treat differently");
    std::optional<std::uint64_t> const begin = index.find(file, line);
    std::optional<std::uint64_t> const end = index.find(file, line + 1);
    if (!begin || !end || *end < *begin)
        return declined(unsteady);
    if (line > index.lineEnds() && *end > *begin)
        return declined("the line has no newline, which versions of sed treat differently");
    if (*end - *begin > longestLine)
        return declined("the line is too long");
    std::string text(*end - *begin, '\0');
    if (!readAt(file, text.data(), text.size(), *begin))
        return declined(unsteady);
    return {std::move(text)};
}

/**
 * Works on the file with its updated index. Only the last file's index is kept, since the plug-in
 * reads a single log.
 */
Answer withIndex(Operands const& operands,
                 Answer (*work)(int file, LineIndex const& index, Operands const& operands))
{
    static auto& lock = *new std::mutex; // threads may run to the very end of the process
    static auto& index = *new LineIndex;
    // Opening never waits, as it would for a pipe.
    mihost::Descriptor const opened(
        open(operands.name.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    int const file = opened.get();
    std::lock_guard const held(lock);
    struct stat before {
    };
    if (Reason const reason = doubt(file, before))
        return declined(reason);
    if (!index.update(file, before))
        return declined(unsteady);
    Answer answer = work(file, index, operands);
    // What is appended from here on would also be missing from a command that started earlier.
    struct stat after {
    };
    if (fstat(file, &after) != 0 || after.st_size < before.st_size)
        return declined(unsteady);
    return answer;
}

} // namespace

Answer wc(Operands const& operands)
{
    return withIndex(operands, countText);
}

Answer sed(Operands const& operands)
{
    return withIndex(operands, lineText);
}

} // namespace miaccel
