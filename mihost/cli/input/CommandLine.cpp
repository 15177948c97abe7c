#include "mihost/cli/input/CommandLine.h"

#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

/** What to type for the help that fits the words given. */
std::string helpFor(CLI::App const& app, bool inShell)
{
    auto const chosen = app.get_subcommands();
    if (chosen.empty())
        return inShell ? "help" : "mihost --help";
    return fmt::format(inShell ? "help {}" : "mihost {} --help", chosen.front()->get_name());
}

std::vector<std::string> commandNames(CLI::App const& app)
{
    std::vector<std::string> names;
    for (CLI::App const* command : app.get_subcommands({}))
        names.push_back(command->get_name());
    return names;
}

/** Those that may stand where the words were given. */
std::vector<std::string> optionNames(CLI::App const& app)
{
    std::vector<std::string> names;
    auto const add = [&names](CLI::App const& one) {
        for (CLI::Option const* option : one.get_options())
            for (std::string const& name : option->get_lnames())
                names.push_back("--" + name);
    };
    add(app);
    for (CLI::App const* command : app.get_subcommands())
        add(*command);
    return names;
}

/** What is wrong with the first word that nothing takes. */
std::string excessOf(CLI::App const& app, std::string const& help)
{
    std::string const word = app.remaining(true).front();
    if (word[0] == '-') {
        std::string const meant = nearest(word.substr(0, word.find('=')), optionNames(app));
        return meant.empty() ? fmt::format("no option '{}' ({} tells more)", word, help)
                             : fmt::format("no option '{}'; did you mean {}?", word, meant);
    }
    if (app.get_subcommands().empty())
        return fmt::format("no command '{}'; {} ({} tells more)", word,
                           suggestion(word, commandNames(app), "there are"), help);
    return fmt::format("'{}' is one argument too many ({} tells more)", word, help);
}

} // namespace

CommandLine::CommandLine(CommandTable const& table, Place place, Options const& defaults)
    : table_(table), place_(place), options_(defaults)
{
}

void CommandLine::declareForProgram(CLI::App& app)
{
    app.set_version_flag("--version", "mihost " MIHOST_VERSION);
    app.add_option("--plugin", options_.plugin, "load this plug-in file")->type_name("FILE");
    app.add_option("--trace", options_.trace,
                   "write every log message to FILE, - for standard error")
        ->type_name("FILE");
    app.add_flag("--sandbox", options_.sandbox,
                 "run everything in a copy of this machine; nothing on the machine changes");
    app.add_option("--overlay", options_.overlay, "lay the files of DIR over the sandbox first")
        ->type_name("DIR");
    app.add_flag("--no-accel", options_.noAccel,
                 "run every command of the plug-in, also those that could be answered in-process");
    app.add_flag("--timing", options_.timing,
                 "show the time of each phase of the start, and what was answered in-process");
}

void CommandLine::declare(CLI::App& app)
{
    app.fallthrough();
    app.set_help_all_flag("--help-all", "help for every command");
    if (place_ == Place::Program)
        declareForProgram(app);
    app.add_flag("--json", options_.json, "print JSON");
    app.add_flag("--show-secrets", options_.showSecrets, "show password hashes");
    app.add_flag("--yes", options_.yes, "do what would be asked about without asking");
    app.add_option("--lock-timeout", options_.lockTimeout,
                   "give up after S seconds if another mihost is changing this machine")
        ->check(CLI::Range(0U, 86400U))
        ->type_name("S")
        ->capture_default_str();
    app.require_subcommand(0, 1);

    for (CommandRow const& row : table_) {
        if (place_ == Place::Shell && row.notInShell)
            continue;
        all_.emplace_back(row.name, row.make());
        all_.back().second->declare(*app.add_subcommand(row.name, row.summary));
    }
}

void CommandLine::parse(std::vector<std::string> words)
{
    bool const inShell = place_ == Place::Shell;
    CLI::App app(inShell
                     ? "Commands run on the loaded plug-in. help COMMAND tells more, exit leaves."
                     : "Loads the management-interface plug-in, shows its tree and drives it.\n"
                       "Without a command it shows the tree; mihost COMMAND --help tells of one.",
                 inShell ? "" : "mihost");
    declare(app);
    try {
        std::reverse(words.begin(), words.end()); // as it wants them
        app.parse(words);
    } catch (CLI::CallForHelp const&) {
        answer_ = app.help();
        return;
    } catch (CLI::CallForAllHelp const&) {
        answer_ = app.help("", CLI::AppFormatMode::All);
        return;
    } catch (CLI::CallForVersion const& version) {
        answer_ = fmt::format("{}\n", version.what());
        return;
    } catch (CLI::ExtrasError const&) {
        throw Failure(BadUsage, excessOf(app, helpFor(app, inShell)));
    } catch (CLI::ParseError const& error) {
        throw Failure(BadUsage,
                      fmt::format("{} ({} tells more)", error.what(), helpFor(app, inShell)));
    }
    options_.sandbox = options_.sandbox || !options_.overlay.empty();
    auto const chosen = app.get_subcommands();
    std::string const name = chosen.empty() ? "tree" : chosen.front()->get_name();
    for (auto const& [known, command] : all_)
        if (known == name)
            command_ = command.get();
    for (CommandRow const& row : table_)
        if (row.name == name && row.alwaysInSandbox)
            options_.sandbox = true;
}

} // namespace mihost
