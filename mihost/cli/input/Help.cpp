#include "mihost/cli/input/Help.h"

#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <algorithm>
#include <fmt/format.h>
#include <string_view>

namespace mihost
{

namespace
{

constexpr std::string_view programPrefix = "mihost ";

bool isInShell(CLI::App const& command)
{
    CLI::App const* app = &command;
    while (app->get_parent())
        app = app->get_parent();
    return app->get_name().empty();
}

std::string lineOf(Example const& example, bool inShell)
{
    std::string_view line = example.line;
    if (inShell && line.substr(0, programPrefix.size()) == programPrefix)
        line.remove_prefix(programPrefix.size());
    return std::string(line);
}

/** Shows a command that either takes its arguments or has a command below it with two usage lines.
 */
class HelpFormatter : public CLI::Formatter
{
public:
    std::string make_usage(CLI::App const* app, std::string name) const override
    {
        auto const isArgument = [](CLI::Option const* option) { return option->get_positional(); };
        auto const arguments = app->get_options(isArgument);
        if (arguments.empty() || app->get_subcommands({}).empty())
            return Formatter::make_usage(app, name);
        std::string const start = fmt::format("{} [{}] ", name, get_label("OPTIONS"));
        std::string usage = fmt::format("{}: {}", get_label("Usage"), start);
        std::size_t const indent = usage.size() - start.size();
        for (CLI::Option const* argument : arguments)
            usage += argument->get_name();
        return fmt::format("{}\n{:{}}{}{} ...\n", usage, "", indent, start,
                           get_label("SUBCOMMAND"));
    }
};

} // namespace

void setHelpLabels(CLI::App& app)
{
    auto const formatter = std::make_shared<HelpFormatter>();
    formatter->label("Positionals", "Arguments");
    formatter->label("REQUIRED", "(required)");
    formatter->label("SUBCOMMAND", "COMMAND");
    app.formatter(formatter);
    app.set_help_flag("-h,--help", "show help");
    app.set_help_all_flag("--help-all", "show help for every command");
}

void setExamples(CLI::App& command, Example const (&examples)[2])
{
    bool const inShell = isInShell(command);
    std::size_t width = 0;
    for (Example const& example : examples)
        width = std::max(width, lineOf(example, inShell).size());
    std::string text = "Examples:";
    for (Example const& example : examples)
        text += fmt::format("\n  {:<{}}  {}", lineOf(example, inShell), width, example.meaning);
    command.footer(text);
}

std::vector<std::string> commandNames(CLI::App const& app)
{
    std::vector<std::string> names;
    for (CLI::App const* command : app.get_subcommands({}))
        names.push_back(command->get_name());
    return names;
}

CLI::App* findCommand(CLI::App& app, std::string const& name)
{
    auto const found = app.get_subcommands(
        [&name](CLI::App const* command) { return command->get_name() == name; });
    return found.empty() ? nullptr : found.front();
}

std::vector<CLI::App const*> givenCommands(CLI::App const& app)
{
    std::vector<CLI::App const*> path = {&app};
    while (!path.back()->get_subcommands().empty())
        path.push_back(path.back()->get_subcommands().front());
    return path;
}

std::string helpOn(CLI::App& app, std::vector<std::string> const& words)
{
    CLI::App* command = &app;
    std::string parents;
    for (std::string const& word : words) {
        std::vector<std::string> const names = commandNames(*command);
        CLI::App* const next = findCommand(*command, word);
        if (!next && names.empty())
            throw Failure(BadUsage, fmt::format("help: unexpected argument '{}'", word));
        if (!next)
            throw Failure(BadUsage, fmt::format("help: no command '{}' ({})", word,
                                                suggestion(word, names, "use")));
        parents += (parents.empty() ? "" : " ") + command->get_name();
        command = next;
    }
    return command->help(parents);
}

} // namespace mihost
