#include "mihost/cli/output/Output.h"

#include "mihost/cli/output/Document.h"
#include "mihost/cli/output/Pager.h"
#include "mihost/cli/output/Rows.h"
#include "mihost/cli/output/Style.h"
#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/system/Failure.h"

#include <cerrno>
#include <cstring>
#include <fmt/format.h>
#include <utility>

namespace mihost
{

namespace
{

std::string rowsText(Table const& table, Options const& options)
{
    return options.format == Format::CsvText ? csvText(table, !options.noHeaders)
                                             : valueText(table);
}

} // namespace

Output::Output(std::FILE* stream) : stream_(stream) {}

void Output::write(std::string_view text)
{
    if (held_) {
        held_->append(text);
        return;
    }
    if (std::fwrite(text.data(), 1, text.size(), stream_) != text.size())
        fail();
    size_ += text.size();
}

void Output::line(std::string_view text)
{
    std::string const whole = std::string(text) + '\n';
    write(held_ ? whole : shown(whole));
}

std::string Output::shown(std::string_view text) const
{
    return takesColours(descriptor(), options_.colours) ? withColours(text) : withoutStyles(text);
}

void Output::lines(std::vector<std::string> const& texts)
{
    for (std::string const& text : texts)
        line(text);
}

void Output::json(Json const& document)
{
    write(documentText(document, options_.format));
}

void Output::table(Table const& table)
{
    if (isDocument(options_.format))
        json(toJson(table));
    else if (isRows(options_.format))
        write(rowsText(table, options_));
    else
        lines(layOut(table, room(), !options_.noHeaders));
}

void Output::record(Table const& table)
{
    if (isDocument(options_.format))
        json(toJson(table).front());
    else if (isRows(options_.format))
        write(rowsText(table, options_));
    else
        lines(layOutRecords(table, room()));
}

bool Output::mayPage() const
{
    return options_.format == Format::TableText && !options_.noPager &&
           takesControls(descriptor()) && terminal::canAsk();
}

void Output::paged(std::function<void()> const& step)
{
    std::string const command = mayPage() ? pagerCommand() : "";
    if (command.empty()) {
        step();
        return;
    }
    held_.emplace();
    try {
        step();
    } catch (...) {
        held_.reset();
        throw;
    }
    std::string const text = *std::exchange(held_, std::nullopt);
    bool const isPaged = !terminal::fits(descriptor(), text) && showInPager(command, shown(text));
    if (!isPaged)
        write(shown(text));
}

void Output::flush()
{
    if (std::fflush(stream_) != 0)
        fail();
}

Room Output::room() const
{
    unsigned int const width = options_.full ? 0 : terminal::width(descriptor());
    return {width == 0 ? Room::unlimited : width, terminal::hasUnicode()};
}

void Output::fail()
{
    int const problem = errno;
    if (problem == EPIPE)
        throw OutputClosed();
    throw Failure(BadUsage, fmt::format("cannot write the output: {}", std::strerror(problem)));
}

} // namespace mihost
