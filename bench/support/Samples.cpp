#include "bench/support/Samples.h"

#include <algorithm>
#include <cstdio>

namespace
{

/** @return the value that this share of all does not exceed, interpolated between two samples */
double quantile(Samples samples, double share)
{
    std::sort(samples.begin(), samples.end());
    double const at = share * static_cast<double>(samples.size() - 1);
    auto const below = static_cast<std::size_t>(at);
    std::size_t const above = std::min(below + 1, samples.size() - 1);
    return samples[below] + (samples[above] - samples[below]) * (at - static_cast<double>(below));
}

} // namespace

double median(Samples samples)
{
    return quantile(std::move(samples), 0.5);
}

std::string number(double value, int digits)
{
    char text[64];
    std::snprintf(text, sizeof text, "%.*f", digits, value);
    std::string grouped = text;
    std::size_t const point = std::min(grouped.find('.'), grouped.size());
    std::size_t const first = grouped[0] == '-' ? 1 : 0;
    for (std::size_t at = point; at > first + 3; at -= 3)
        grouped.insert(at - 3, ",");
    return grouped;
}

std::string shown(Samples const& samples, int digits)
{
    return number(median(samples), digits) + " [" + number(quantile(samples, 0.25), digits) + ", " +
           number(quantile(samples, 0.75), digits) + "]";
}

Samples ratios(Samples const& above, Samples const& below)
{
    Samples result(above.size());
    std::transform(above.begin(), above.end(), below.begin(), result.begin(),
                   [](double one, double other) { return one / other; });
    return result;
}

void byTurns(std::size_t rounds, std::vector<std::function<void()>> const& runs)
{
    for (std::size_t round = 0; round < rounds; ++round)
        for (std::size_t turn = 0; turn < runs.size(); ++turn)
            runs[round % 2 == 0 ? turn : runs.size() - 1 - turn]();
}
