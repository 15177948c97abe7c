#ifndef INTEGRATIONS_PROMETHEUS_EXPORTER_SCRAPE_H
#define INTEGRATIONS_PROMETHEUS_EXPORTER_SCRAPE_H

#include <chrono>
#include <optional>
#include <string>
#include <vector>

/**
 * A program's standard output, regardless of its exit status.
 *
 * @return nothing if it cannot be started, prints nothing, or runs too long and is killed
 */
std::optional<std::string> scrape(std::vector<std::string> const& command,
                                  std::chrono::milliseconds timeLimit);

#endif
