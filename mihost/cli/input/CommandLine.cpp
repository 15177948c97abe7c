#include "mihost/cli/input/CommandLine.h"

#include "mihost/cli/input/Help.h"
#include "mihost/cli/input/Range.h"
#include "mihost/cli/input/Remote.h"
#include "mihost/cli/input/UsageError.h"
#include "mihost/cli/system/Failure.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

Colours coloursOf(std::string const& name)
{
    if (name == "auto")
        return Colours::Auto;
    return name == "always" ? Colours::Always : Colours::Never;
}

/** @throws Failure (BadUsage) if the command's results do not come in that format */
void checkFormat(Format format, Command const& command, std::string const& name)
{
    if (isRows(format) && !command.hasRows())
        throw Failure(BadUsage,
                      fmt::format("{}: -o {} is not supported (use table, json, jsonl or yaml)",
                                  name, nameOf(format)));
}

/** Leaves out the types of arguments, since their names say the same. */
void hideTypesOfArguments(CLI::App& command)
{
    for (CLI::Option* option : command.get_options())
        if (option->get_positional() && option->get_type_name() == "TEXT")
            option->type_name("");
    for (CLI::App* each : command.get_subcommands({}))
        hideTypesOfArguments(*each);
}

constexpr char helpCommand[] = "help";

} // namespace

CommandLine::CommandLine(CommandTable const& table, Place place, Options const& defaults)
    : table_(table), place_(place), options_(defaults)
{
}

void CommandLine::declareForProgram(CLI::App& app)
{
    app.set_version_flag("--version", "mihost " MIHOST_VERSION, "show the version");
    app.add_option("-H,--host", options_.host,
                   "run the command on HOST by ssh, with the mihost installed there")
        ->type_name("[USER@]HOST")
        ->each(expectHost);
    app.add_option("--plugin", options_.plugin, "load this plug-in file")->type_name("FILE");
    app.add_option("--trace", options_.trace,
                   "write every log message to FILE, - for standard error")
        ->type_name("FILE");
    app.add_flag("--sandbox", options_.sandbox,
                 "run everything in a copy of this machine, without changing it");
    app.add_option("--overlay", options_.overlay,
                   "replace files of the sandbox by those of DIR; implies --sandbox")
        ->type_name("DIR");
    app.add_flag("--no-accel", options_.noAccel,
                 "turn the accelerator off: run every command of the plug-in");
    app.add_flag("--timing", options_.timing,
                 "show the time of each start-up phase, and which commands were accelerated");
}

void CommandLine::setFormat(Format format)
{
    if (isFormatGiven_)
        throw CLI::ValidationError("--json and -o cannot be combined");
    isFormatGiven_ = true;
    options_.format = format;
}

void CommandLine::declareOutput(CLI::App& app)
{
    choices_.restrict(app.add_option_function<std::string>(
                          "-o,--output-format",
                          [this](std::string const& name) { setFormat(formatOf(name)); },
                          "print results in this format"),
                      formatNames());
    app.add_flag_callback(
        "--json", [this] { setFormat(Format::JsonText); }, "same as -o json");
    app.add_flag("--no-headers", options_.noHeaders, "omit the headings of tables and CSV");
    app.add_flag("--full", options_.full, "do not wrap at the width of the terminal");
    app.add_flag("--no-pager", options_.noPager, "do not page long tables and trees");
    choices_.restrict(app.add_option_function<std::string>(
                          "--color",
                          [this](std::string const& when) { options_.colours = coloursOf(when); },
                          "when to use colours"),
                      {"auto", "always", "never"});
    app.add_flag("-q,--quiet", options_.quiet, "suppress warnings and progress");
}

void CommandLine::declare(CLI::App& app)
{
    app.fallthrough();
    setHelpLabels(app);
    if (place_ == Place::Program)
        declareForProgram(app);
    declareOutput(app);
    app.add_flag("--show-secrets", options_.showSecrets, "show password hashes");
    app.add_flag("-y,--yes", options_.yes, "answer yes to all prompts");
    app.add_option("--lock-timeout", options_.lockTimeout,
                   "wait at most S seconds while another mihost changes this machine")
        ->check(wholeBetween(0, 86400))
        ->type_name("S")
        ->capture_default_str();
    app.require_subcommand(0, 1);
    declareCommands(app);
    setExamples(app, {{"mihost get os", "the operating system's properties"},
                      {"mihost --sandbox user add asmith", "try adding an account"}});
    hideTypesOfArguments(app);
}

void CommandLine::declareCommands(CLI::App& app)
{
    for (CommandRow const* row : table_) {
        if (place_ == Place::Shell && row->has(CommandRow::NotInShell))
            continue;
        CLI::App& command = *app.add_subcommand(row->name, row->summary)->group("Commands");
        all_.push_back({row, row->make()});
        all_.back().command->declare(command);
        setExamples(command, row->examples);
    }
    CLI::App& help = *app.add_subcommand(helpCommand, "show help for a command")->group("Commands");
    help.add_option("COMMAND", helpWords_, "such as get, or user add");
    setExamples(help, {{"mihost help get", "the arguments and options of get"},
                       {"mihost help user add", "those of one task"}});
}

Choices const* CommandLine::choicesOf(CLI::Option const& option) const
{
    for (Declared const& each : all_)
        if (Choices const* const choices = each.command->choices().find(option))
            return choices;
    return choices_.find(option);
}

void CommandLine::choose(std::string const& name)
{
    for (Declared const& each : all_)
        if (each.row->name == name) {
            command_ = each.command.get();
            checkFormat(options_.format, *command_, name);
            options_.sandbox = options_.sandbox || each.row->has(CommandRow::AlwaysSandbox);
        }
}

void CommandLine::parse(std::vector<std::string> words)
{
    bool const inShell = place_ == Place::Shell;
    CLI::App app(
        inShell ? "Commands run on the loaded plug-in. Run 'help COMMAND' for details, exit to "
                  "leave."
                : "Loads the management-interface plug-in, and shows and changes its tree.\n"
                  "Without a command it shows the tree. Run 'mihost help COMMAND' for details.",
        inShell ? "" : "mihost");
    declare(app);
    try {
        std::reverse(words.begin(), words.end()); // in the order that CLI11 expects
        app.parse(words);
        if (app.got_subcommand(helpCommand)) {
            app.clear(); // otherwise it would show the help for help
            answer_ = helpOn(app, helpWords_);
            return;
        }
    } catch (CLI::CallForHelp const&) {
        answer_ = app.help();
        return;
    } catch (CLI::CallForAllHelp const&) {
        answer_ = app.help("", CLI::AppFormatMode::All);
        return;
    } catch (CLI::CallForVersion const& version) {
        answer_ = fmt::format("{}\n", version.what());
        return;
    } catch (CLI::ParseError const& error) {
        throw usageFailure(app, error, inShell);
    }
    options_.sandbox = options_.sandbox || !options_.overlay.empty();
    auto const chosen = app.get_subcommands();
    choose(chosen.empty() ? "tree" : chosen.front()->get_name());
}

} // namespace mihost
