#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/log/LogLine.h"
#include "mihost/cli/metrics/MachineMetrics.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/ReplacedFile.h"

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <sys/sysinfo.h>

namespace mihost
{

namespace
{

std::uint64_t linesOfLog()
{
    std::ifstream log(systemLog, std::ios::binary);
    return static_cast<std::uint64_t>(
        std::count(std::istreambuf_iterator<char>(log), std::istreambuf_iterator<char>(), '\n'));
}

/** What the metrics need of a node: no live values of users and groups, which each count all. */
NodeView viewOf(IC::MutableNode const& node)
{
    std::string_view const kind = kindName(node.getNodeType());
    if (kind == "user")
        return liveView(node, {"user-name", "password", "inactive-time", "last-password-change"},
                        Secrets::Show);
    if (kind == "group")
        return {&node, {}};
    return storedView(node, Secrets::Show);
}

MachineState stateOf(Session& session)
{
    MachineState state;
    for (IC::MutableNode const* const node : session.nodes())
        state.nodes.push_back(viewOf(*node));
    state.needs = diagnoseMachine();
    // Contract: the tree cuts swap space to 32 bits.
    struct sysinfo info {
    };
    sysinfo(&info);
    state.swapSize = static_cast<std::uint64_t>(info.totalswap) * info.mem_unit;
    state.swapFree = static_cast<std::uint64_t>(info.freeswap) * info.mem_unit;
    state.logLines = linesOfLog();
    state.now = std::time(nullptr);
    return state;
}

Json metricsToJson(std::vector<Metric> const& metrics)
{
    Json list = Json::array();
    for (Metric const& metric : metrics)
        for (Sample const& sample : metric.samples) {
            Json labels = Json::object();
            for (auto const& [name, value] : sample.labels)
                labels[name] = toJson(value);
            list.push_back({{"metric", metric.name}, {"labels", labels}, {"value", sample.value}});
        }
    return list;
}

class Metrics : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("--output", output_, "write the metrics to FILE, replacing it atomically")
            ->type_name("FILE");
        app.add_flag("--accounts", accounts_,
                     "add series for each account, with its name as a label");
    }

    void run(Session& session) override
    {
        if (!output_.empty()) // the plug-in works in another directory
            output_ = std::filesystem::absolute(output_).string();
        auto const start = std::chrono::steady_clock::now();
        std::vector<Metric> metrics;
        std::optional<Failure> problem;
        try {
            metrics = machineMetrics(stateOf(session),
                                     accounts_ ? AccountSeries::Make : AccountSeries::Leave);
        } catch (Failure const& failure) {
            problem = failure; // the failure is a metric, too
        }
        std::chrono::duration<double> const taken = std::chrono::steady_clock::now() - start;
        for (Metric const& metric : collectionMetrics(!problem, taken.count()))
            metrics.push_back(metric);
        write(metrics, session);
        if (problem)
            throw Failure(*problem);
    }

private:
    void write(std::vector<Metric> const& metrics, Session& session) const
    {
        if (!output_.empty())
            replaceFile(output_, metricText(metrics), "writing the metrics");
        else if (session.out().takesDocuments())
            session.out().json(metricsToJson(metrics));
        else
            session.out().write(metricText(metrics));
    }

    std::string output_;
    bool accounts_ = false;
};

} // namespace

CommandRow const commandRows::metrics{
    "metrics",
    "print metrics for Prometheus",
    newCommand<Metrics>,
    {
        {"mihost metrics", "print the metrics"},
        {"mihost metrics --output /var/lib/prometheus/node-exporter/mihost.prom",
         "replace a file that node_exporter reads"},
    },
    CommandRow::NotInShell,
};

} // namespace mihost
