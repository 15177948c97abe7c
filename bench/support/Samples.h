#ifndef BENCH_SUPPORT_SAMPLES_H
#define BENCH_SUPPORT_SAMPLES_H

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

/** What one thing was measured to be, each time. */
using Samples = std::vector<double>;

/** Neither of them is empty. */
double median(Samples samples);

/** "980 [971, 990]": the median and the two quartiles. */
std::string shown(Samples const& samples, int digits = 0);

/** The ratios of alternating measurements, pair by pair. */
Samples ratios(Samples const& above, Samples const& below);

/** Has everybody run once a round, in turning order. */
void byTurns(std::size_t rounds, std::vector<std::function<void()>> const& runs);

std::string number(double value, int digits = 0);

#endif
