#include "mihost/cli/check/Report.h"

#include "mihost/cli/output/Style.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <map>

namespace mihost::checks
{

namespace
{

template <class Holds> std::size_t count(Results const& results, Holds holds)
{
    return static_cast<std::size_t>(std::count_if(results.begin(), results.end(), holds));
}

std::size_t failures(Results const& results)
{
    return count(results, [](Result const& result) { return result.failed(); });
}

std::size_t skips(Results const& results)
{
    return count(results, [](Result const& result) { return result.verdict.skipped.has_value(); });
}

char const* outcomeOf(Result const& result)
{
    if (result.failed())
        return "failed";
    return result.passed() ? "passed" : "skipped";
}

Style styleOf(Result const& result)
{
    if (result.failed())
        return Style::Red;
    return result.passed() ? Style::Green : Style::Yellow;
}

/** As text between XML tags or in an attribute's quotes; control characters have no place there. */
std::string xml(std::string const& text)
{
    static std::map<char, char const*> const entities = {
        {'&', "&amp;"}, {'<', "&lt;"}, {'>', "&gt;"}, {'"', "&quot;"}};
    std::string escaped;
    for (char const character : printable(text)) {
        auto const entity = entities.find(character);
        if (entity == entities.end())
            escaped += character;
        else
            escaped += entity->second;
    }
    return escaped;
}

Cell listCell(std::vector<std::string> const& texts)
{
    return {listToJson(texts), fmt::format("{}", fmt::join(texts, "; "))};
}

std::string scenarioOf(Result const& result)
{
    return result.name.substr(0, result.name.find('.'));
}

std::string testCase(Result const& result)
{
    std::string const& name = result.name;
    std::string content;
    if (result.failed()) {
        content +=
            fmt::format("      <failure message=\"{}\">", xml(result.verdict.findings.front()));
        for (std::string const& finding : result.verdict.findings)
            content += xml(finding) + '\n';
        content += "</failure>\n";
    }
    if (result.verdict.skipped)
        content += fmt::format("      <skipped message=\"{}\"/>\n", xml(*result.verdict.skipped));
    if (!result.verdict.notes.empty()) {
        content += "      <system-out>";
        for (std::string const& note : result.verdict.notes)
            content += xml(note) + '\n';
        content += "</system-out>\n";
    }
    std::string const tag =
        fmt::format("    <testcase classname=\"{}\" name=\"{}\"", xml(scenarioOf(result)),
                    xml(name.substr(name.find('.') + 1)));
    return content.empty() ? tag + "/>\n" : fmt::format("{}>\n{}    </testcase>\n", tag, content);
}

/** The results by scenario, in their order. */
std::vector<Results> byScenario(Results const& results)
{
    std::vector<Results> groups;
    for (Result const& result : results) {
        if (groups.empty() || scenarioOf(groups.back().front()) != scenarioOf(result))
            groups.emplace_back();
        groups.back().push_back(result);
    }
    return groups;
}

} // namespace

void writeText(Results const& results, Output& out)
{
    constexpr char below[] = "           ";
    std::size_t width = 0;
    for (Result const& result : results)
        width = std::max(width, result.name.size());
    for (Result const& result : results) {
        std::string const outcome = fmt::format("{:<9}", outcomeOf(result));
        out.line(fmt::format("{}  {:<{}}  {}", styled(styleOf(result), outcome), result.name, width,
                             result.meaning));
        for (std::string const& finding : result.verdict.findings)
            out.line(below + printable(finding));
        if (result.verdict.skipped)
            out.line(below + printable(*result.verdict.skipped));
        for (std::string const& note : result.verdict.notes)
            out.line(below + ("note: " + printable(note)));
    }
    out.line(fmt::format("{} of {} checks failed, {} skipped", failures(results), results.size(),
                         skips(results)));
}

std::string tapText(Results const& results)
{
    std::string text = fmt::format("TAP version 14\n1..{}\n", results.size());
    std::size_t number = 0;
    for (Result const& result : results) {
        text += fmt::format("{} {} - {}", result.failed() ? "not ok" : "ok", ++number, result.name);
        if (result.verdict.skipped)
            text += fmt::format(" # SKIP {}", printable(*result.verdict.skipped));
        text += '\n';
        if (result.failed()) {
            text += "  ---\n  findings:\n";
            for (std::string const& finding : result.verdict.findings)
                text +=
                    fmt::format("    - {}\n", mihost::toJson(finding).dump()); // YAML reads JSON
            text += "  ...\n";
        }
        for (std::string const& note : result.verdict.notes)
            text += fmt::format("# {}\n", printable(note));
    }
    return text;
}

std::string junitText(Results const& results)
{
    std::string text = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";
    text += fmt::format("<testsuites name=\"mihost check\" tests=\"{}\" failures=\"{}\">\n",
                        results.size(), failures(results));
    for (Results const& group : byScenario(results)) {
        text += fmt::format(
            "  <testsuite name=\"{}\" tests=\"{}\" failures=\"{}\" skipped=\"{}\">\n",
            xml(scenarioOf(group.front())), group.size(), failures(group), skips(group));
        for (Result const& result : group)
            text += testCase(result);
        text += "  </testsuite>\n";
    }
    return text + "</testsuites>\n";
}

Table tableOf(Results const& results)
{
    Table table({{"check"}, {"outcome"}, {"meaning"}, {"findings"}, {"notes"}, {"skipped"}});
    for (Result const& result : results)
        table.add({result.name, outcomeOf(result), result.meaning,
                   listCell(result.verdict.findings), listCell(result.verdict.notes),
                   result.verdict.skipped ? Cell(*result.verdict.skipped) : Cell(nullptr, "")});
    return table;
}

} // namespace mihost::checks
