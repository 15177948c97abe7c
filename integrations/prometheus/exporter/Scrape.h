#ifndef INTEGRATIONS_PROMETHEUS_EXPORTER_SCRAPE_H
#define INTEGRATIONS_PROMETHEUS_EXPORTER_SCRAPE_H

#include <chrono>
#include <optional>
#include <string>
#include <vector>

/**
 * What a program prints on standard output, whatever its exit status.
 *
 * @return nothing if it cannot be started, prints nothing, or has not ended in time; it is killed
 * then
 */
std::optional<std::string> scrape(std::vector<std::string> const& command,
                                  std::chrono::milliseconds timeLimit);

#endif
