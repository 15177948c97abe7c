#include "mihost/cli/plugin/AcceleratorLoader.h"

#include "mihost/accel/Accel.h"
#include "mihost/cli/plugin/CommandTap.h"

#include <dlfcn.h>
#include <fmt/format.h>

namespace mihost
{

namespace
{

template <class Function> Function* find(void* library, char const* name)
{
    return reinterpret_cast<Function*>(dlsym(library, name));
}

Accelerator::Row rowOf(miaccel_count const& count)
{
    return {count.command, count.answered, count.ran, count.reason ? count.reason : ""};
}

} // namespace

Accelerator::Accelerator() : library_(dlopen(MIHOST_ACCELERATOR, RTLD_NOW | RTLD_LOCAL))
{
    if (library_)
        commandTap::setRunner({find<commandTap::Runner::Open>(library_, "popen"),
                               find<commandTap::Runner::Close>(library_, "pclose")});
    else
        problem_ = dlerror();
}

std::vector<Accelerator::Row> Accelerator::rows() const
{
    if (!library_)
        return {{"all", 0, commandTap::count(), problem_}};
    auto* const counts = find<decltype(miaccel_counts)>(library_, "miaccel_counts");
    std::vector<miaccel_count> all(counts(nullptr, 0));
    counts(all.data(), all.size());
    std::vector<Row> rows;
    for (miaccel_count const& count : all)
        if (count.answered + count.ran > 0)
            rows.push_back(rowOf(count));
    return rows;
}

std::string answersText(std::vector<Accelerator::Row> const& rows)
{
    std::string text;
    for (Accelerator::Row const& row : rows)
        text += fmt::format("{:<20} {:>10} answered {:>6} run{}{}\n", row.command, row.answered,
                            row.run, row.reason.empty() ? "" : ": ", row.reason);
    return text;
}

Json toJson(std::vector<Accelerator::Row> const& rows)
{
    Json list = Json::array();
    for (Accelerator::Row const& row : rows)
        list.push_back({{"command", row.command},
                        {"answered", row.answered},
                        {"run", row.run},
                        {"reason", row.reason.empty() ? Json() : Json(row.reason)}});
    return list;
}

} // namespace mihost
