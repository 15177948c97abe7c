#include "mihost/accel/IndexedFile.h"

#include <map>
#include <memory>
#include <mutex>

namespace miaccel
{

namespace
{

constexpr std::size_t mostFiles = 16;
constexpr int attempts = 4;

struct KeptIndex {
    std::mutex lock;
    LineIndex index;
};

/** The path's own index. Never destroyed: threads may run to the very end of the process. */
std::shared_ptr<KeptIndex> indexOf(std::string const& path)
{
    static auto& lock = *new std::mutex;
    static auto& indexes = *new std::map<std::string, std::shared_ptr<KeptIndex>>;
    std::lock_guard const held(lock);
    if (indexes.size() >= mostFiles && indexes.count(path) == 0)
        indexes.clear();
    std::shared_ptr<KeptIndex>& kept = indexes[path];
    if (!kept)
        kept = std::make_shared<KeptIndex>();
    return kept;
}

/** Nothing where the file changed in any other way than by growing. */
std::optional<Answer> attempt(TextFile const& file, LineIndex& index, Work const& work)
{
    std::optional<FileStamp> const before = file.stamp();
    if (!before || !index.update(file))
        return std::nullopt;
    std::optional<Answer> answer = work(file, index);
    std::optional<FileStamp> const after = file.stamp();
    if (!after || !after->isSameOrLonger(*before))
        return std::nullopt;
    return answer;
}

} // namespace

Answer withIndexedFile(std::string const& path, Work const& work)
{
    TextFile const file(path);
    if (file.declined())
        return Answer::none(file.declined());
    std::shared_ptr<KeptIndex> const kept = indexOf(path);
    std::lock_guard const held(kept->lock);
    for (int i = 0; i < attempts; ++i)
        if (std::optional<Answer> answer = attempt(file, kept->index, work))
            return *std::move(answer);
    return Answer::none("the file changes while it is read");
}

} // namespace miaccel
