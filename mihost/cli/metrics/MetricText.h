#ifndef MIHOST_CLI_METRICS_METRICTEXT_H
#define MIHOST_CLI_METRICS_METRICTEXT_H

#include <string>
#include <utility>
#include <vector>

namespace mihost
{

/** One value of a time series. */
struct Sample {
    std::vector<std::pair<std::string, std::string>> labels;
    double value;
};

/** Time series of one name. */
struct Metric {
    char const* name;
    char const* unit; // the end of the name, such as "bytes"; "" for none
    char const* help;
    std::vector<Sample> samples;
};

/**
 * The metrics as OpenMetrics text.
 *
 * This is also valid in Prometheus' older text format, which node_exporter's textfile collector
 * reads: every metric is a gauge, and additions of OpenMetrics are comments there.
 *
 * Of samples with the same labels, such as those of accounts with the same name, only the first one
 * is written: with both, node_exporter would answer no scrape at all.
 */
std::string metricText(std::vector<Metric> const& metrics);

} // namespace mihost

#endif
