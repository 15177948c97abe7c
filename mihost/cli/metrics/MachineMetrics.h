#ifndef MIHOST_CLI_METRICS_MACHINEMETRICS_H
#define MIHOST_CLI_METRICS_MACHINEMETRICS_H

#include "mihost/cli/doctor/Diagnosis.h"
#include "mihost/cli/metrics/MetricText.h"
#include "mihost/cli/output/NodeView.h"

#include <cstdint>
#include <ctime>

namespace mihost
{

/** What the metrics are made of. */
struct MachineState {
    std::vector<NodeView> nodes; // with secrets
    std::vector<Need> needs;     // those that depend on the machine alone
    std::uint64_t swapSize = 0;  // bytes
    std::uint64_t swapFree = 0;  // bytes
    std::uint64_t logLines = 0;  // of the whole log
    std::time_t now = 0;
};

/** Whether series of single accounts are wanted: their names are then labels. */
enum class AccountSeries { Leave, Make };

std::vector<Metric> machineMetrics(MachineState const& state, AccountSeries accounts);

/** How the collection itself went. */
std::vector<Metric> collectionMetrics(bool success, double seconds);

} // namespace mihost

#endif
