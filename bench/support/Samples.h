#ifndef BENCH_SUPPORT_SAMPLES_H
#define BENCH_SUPPORT_SAMPLES_H

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

/** The results of repeated measurements of one thing. */
using Samples = std::vector<double>;

/** Neither of them is empty. */
double median(Samples samples);

/** "980 [971, 990]": the median and the two quartiles. */
std::string shown(Samples const& samples, int digits = 0);

/** The ratios of alternating measurements, pair by pair. */
Samples ratios(Samples const& above, Samples const& below);

/** Calls each function once per round, in turn forwards and backwards. */
void byTurns(std::size_t rounds, std::vector<std::function<void()>> const& runs);

std::string number(double value, int digits = 0);

#endif
