#include "mihost/cli/input/UsageError.h"

#include "mihost/cli/input/Help.h"
#include "mihost/cli/input/Suggestion.h"

#include <fmt/format.h>
#include <string_view>

namespace mihost
{

namespace
{

/** The commands that were given, as they are typed. */
std::string wordsOf(std::vector<CLI::App const*> const& commands)
{
    std::string words;
    for (CLI::App const* command : commands)
        words += (words.empty() ? "" : " ") + command->get_name();
    return words;
}

/** What to type for the help that fits the words given. */
std::string helpFor(CLI::App const& app, bool inShell)
{
    std::string const words = wordsOf(givenCommands(app));
    if (!inShell)
        return words + " --help";
    return words.empty() ? "help" : "help " + words;
}

/** The options allowed at this place. */
std::vector<std::string> optionNames(CLI::App const& app)
{
    std::vector<std::string> names;
    for (CLI::App const* command : givenCommands(app))
        for (CLI::Option const* option : command->get_options())
            for (std::string const& name : option->get_lnames())
                names.push_back("--" + name);
    return names;
}

/** The argument in the place of a subcommand; empty for none. */
std::string wordForCommand(CLI::App const& command)
{
    if (command.get_subcommands({}).empty())
        return "";
    for (CLI::Option const* option : command.get_options())
        if (option->get_positional() && option->count() > 0)
            return option->results().front();
    return "";
}

/** The error for the first unexpected word. */
std::string excessOf(CLI::App const& app, std::string const& help)
{
    std::string const word = app.remaining(true).front();
    CLI::App const& command = *givenCommands(app).back();
    if (word[0] == '-') {
        std::string const meant = nearest(word.substr(0, word.find('=')), optionNames(app));
        return meant.empty() ? fmt::format("no option '{}' (see '{}')", word, help)
                             : fmt::format("no option '{}' (did you mean {}?)", word, meant);
    }
    if (&command == &app)
        return fmt::format("no command '{}' ({})", word,
                           suggestion(word, commandNames(app), "use"));
    std::string const before = wordForCommand(command);
    if (std::string const meant = nearest(before, commandNames(command)); !meant.empty())
        return fmt::format("no command '{}' (did you mean {}?)", before, meant);
    return fmt::format("unexpected argument '{}' (see '{}')", word, help);
}

bool endsWith(std::string_view text, std::string_view end)
{
    return text.size() >= end.size() && text.substr(text.size() - end.size()) == end;
}

/** Such as "[USER@]HOST"; empty for an unknown option. */
std::string valueName(CLI::App const& app, std::string_view option)
{
    for (CLI::App const* command : givenCommands(app))
        for (CLI::Option const* each : command->get_options())
            if (each->get_name() == option)
                return each->get_type_name();
    return "";
}

/** CLI11's message in plainer words. */
std::string reworded(CLI::App const& app, std::string const& message)
{
    constexpr std::string_view unconverted = "Could not convert: ";
    if (message.compare(0, unconverted.size(), unconverted) == 0) {
        // Every value of an option is checked before, so this is a flag.
        std::string const rest = message.substr(unconverted.size());
        return rest.substr(0, rest.find(" = ")) + " takes no value";
    }
    std::string const name = message.substr(0, message.find(": "));
    if (endsWith(message, " missing"))
        return fmt::format("{0}: no value given (write {0} {1})", name, valueName(app, name));
    if (message.find(": At Most 1 required") == name.size())
        return name + ": given more than once";
    return message;
}

/** @return the message, with its command before it and a hint after it */
std::string explained(CLI::App const& app, std::string const& message, std::string const& help)
{
    std::vector<CLI::App const*> commands = givenCommands(app);
    commands.erase(commands.begin());
    std::string const what = wordsOf(commands);
    bool const hasWayOn = !message.empty() && message.back() == ')';
    return fmt::format("{}{}{}{}", what, what.empty() ? "" : ": ", message,
                       hasWayOn ? "" : fmt::format(" (see '{}')", help));
}

} // namespace

Failure usageFailure(CLI::App const& app, CLI::ParseError const& error, bool inShell)
{
    std::string const help = helpFor(app, inShell);
    bool const isExcess = dynamic_cast<CLI::ExtrasError const*>(&error) != nullptr;
    std::string const message = isExcess ? excessOf(app, help) : reworded(app, error.what());
    return {BadUsage, explained(app, message, help)};
}

} // namespace mihost
