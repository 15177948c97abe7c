#include "mihost/accel/Tool.h"

#include "mihost/accel/FileStamp.h"
#include "mihost/accel/Packages.h"

#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <unistd.h>

namespace miaccel
{

namespace
{

struct Verdict {
    FileStamp stamp;
    bool genuine;
};

bool isGenuine(Tool const& tool, FileStamp const& now)
{
    static auto& lock = *new std::mutex;
    static auto& verdicts = *new std::map<std::string, Verdict>;
    if (!now.isRegular())
        return false;
    std::lock_guard const held(lock);
    auto const known = verdicts.find(tool.path);
    if (known != verdicts.end() && now.isUnchangedSince(known->second.stamp))
        return known->second.genuine;
    bool const genuine = isFromPackage(tool.path, tool.package, tool.versions);
    verdicts.insert_or_assign(tool.path, Verdict{now, genuine});
    return genuine;
}

} // namespace

bool isGenuine(Tool const& tool)
{
    std::optional<FileStamp> const now = FileStamp::of(tool.path);
    return now && isGenuine(tool, *now);
}

bool leadsTo(char const* path, Tool const& tool)
{
    std::optional<FileStamp> const asked = FileStamp::of(path);
    std::optional<FileStamp> const own = FileStamp::of(tool.path);
    return asked && own && asked->isSameFile(*own) && access(path, X_OK) == 0 &&
           isGenuine(tool, *own);
}

} // namespace miaccel
