#include "mihost/cli/metrics/MetricText.h"

#include "mihost/runtime/Text.h"

#include <fmt/format.h>
#include <fmt/ranges.h>
#include <set>

namespace mihost
{

namespace
{

/** A label's value; bytes that are not UTF-8 would end a scrape. */
std::string escaped(std::string const& text)
{
    std::string result;
    for (char const c : validUtf8(text)) {
        if (c == '\\' || c == '"')
            result += '\\';
        if (c == '\n')
            result += "\\n";
        else
            result += c;
    }
    return result;
}

std::string labelText(Sample const& sample)
{
    std::vector<std::string> pairs;
    for (auto const& [name, value] : sample.labels)
        pairs.push_back(fmt::format("{}=\"{}\"", name, escaped(value)));
    return pairs.empty() ? "" : fmt::format("{{{}}}", fmt::join(pairs, ","));
}

} // namespace

std::string metricText(std::vector<Metric> const& metrics)
{
    std::string text;
    for (Metric const& metric : metrics) {
        text += fmt::format("# HELP {0} {1}\n# TYPE {0} gauge\n", metric.name, metric.help);
        if (*metric.unit)
            text += fmt::format("# UNIT {} {}\n", metric.name, metric.unit);
        std::set<std::string> written;
        for (Sample const& sample : metric.samples)
            if (std::string const labels = labelText(sample); written.insert(labels).second)
                text += fmt::format("{}{} {}\n", metric.name, labels, sample.value);
    }
    return text + "# EOF\n";
}

} // namespace mihost
