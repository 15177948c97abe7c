#ifndef MIHOST_CLI_METRICS_MACHINEMETRICS_H
#define MIHOST_CLI_METRICS_MACHINEMETRICS_H

#include "mihost/cli/doctor/Diagnosis.h"
#include "mihost/cli/metrics/MetricText.h"
#include "mihost/cli/output/NodeView.h"

#include <cstdint>
#include <ctime>

namespace mihost
{

/** The data of the metrics. */
struct MachineState {
    std::vector<NodeView> nodes; // with secrets
    std::vector<Need> needs;     // the needs that depend only on the machine
    std::uint64_t swapSize = 0;  // bytes
    std::uint64_t swapFree = 0;  // bytes
    std::uint64_t logLines = 0;  // of the whole log
    std::time_t now = 0;
};

/** Whether to include series of single accounts, with their names as labels. */
enum class AccountSeries { Leave, Make };

std::vector<Metric> machineMetrics(MachineState const& state, AccountSeries accounts);

/** How the collection itself went. */
std::vector<Metric> collectionMetrics(bool success, double seconds);

} // namespace mihost

#endif
