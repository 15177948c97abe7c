#include "mihost/cli/shell/Completion.h"

#include "host/Methods.h"
#include "mihost/cli/input/Address.h"
#include "mihost/cli/input/Help.h"
#include "mihost/cli/input/MethodCall.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <algorithm>
#include <fmt/format.h>
#include <memory>

namespace mihost
{

namespace
{

using Candidates = std::vector<Candidate>;

/** A command line up to the word being typed. */
struct Typed {
    Typed(CommandLine const& declared, CLI::App& app)
        : line(&declared), program(&app), command(&app)
    {
    }

    CommandLine const* line; // that the program was declared by
    CLI::App* program;
    CLI::App* command;                  // the program itself before the command
    std::vector<std::string> arguments; // of the command
    CLI::Option* waiting = nullptr;     // an option whose value comes next
    bool isWrong = false;               // no such command or option
    bool onlyArguments = false;         // after --
};

bool beginsWith(std::string const& text, std::string const& start)
{
    return text.compare(0, start.size(), start) == 0;
}

bool looksLikeOption(Typed const& typed, std::string const& word)
{
    return !typed.onlyArguments && word.size() > 1 && word[0] == '-';
}

/** The command's own, or one that holds for all commands. */
CLI::Option* findOption(Typed const& typed, std::string const& name)
{
    for (CLI::App* app = typed.command; app; app = app->get_parent())
        if (CLI::Option* const option = app->get_option_no_throw(name))
            return option;
    return nullptr;
}

/** The name of a short option is a letter, and its value may follow at once. */
std::size_t lengthOfName(std::string const& word)
{
    constexpr std::size_t shortName = 2;
    return word[1] == '-' ? word.find('=') : shortName;
}

void takeOption(Typed& typed, std::string const& word)
{
    std::size_t const length = lengthOfName(word);
    CLI::Option* const option = findOption(typed, word.substr(0, length));
    if (!option)
        typed.isWrong = true;
    else if (option->get_items_expected_max() > 0 && length >= word.size())
        typed.waiting = option;
}

bool mayNameCommand(Typed const& typed)
{
    return !typed.onlyArguments && typed.arguments.empty();
}

void take(Typed& typed, std::string const& word)
{
    if (typed.waiting) {
        typed.waiting = nullptr;
    } else if (word == "--") {
        typed.onlyArguments = true;
    } else if (looksLikeOption(typed, word)) {
        takeOption(typed, word);
    } else if (CLI::App* const command =
                   mayNameCommand(typed) ? findCommand(*typed.command, word) : nullptr) {
        typed.command = command;
    } else if (typed.command == typed.program) {
        typed.isWrong = true;
    } else {
        typed.arguments.push_back(word);
    }
}

NodeKind const* kindAt(std::string const& address)
{
    try {
        return parseAddress(address).kind;
    } catch (Failure const&) {
        return nullptr;
    }
}

Candidates propertiesOf(NodeKind const* kind)
{
    Candidates all;
    if (kind)
        for (Property const& property : kind->properties)
            all.push_back({property.name, property.meaning});
    return all;
}

Candidates names(NodeKind const& kind, std::string const& before, NodeNames const& nodeNames)
{
    Candidates all;
    for (std::string const& name : nodeNames(kind))
        if (printable(name) == name)
            all.push_back({before + name, ""});
    return all;
}

// The candidates for each kind of place, not yet compared with the typed word.

Candidates nodes(Typed const&, std::string const& word, NodeNames const& nodeNames)
{
    Candidates all;
    for (NodeKind const& kind : nodeKinds()) {
        std::string const start = fmt::format("{}:", kind.address);
        if (kind.single) {
            all.push_back({kind.address, kind.meaning});
        } else if (beginsWith(word, start)) {
            return names(kind, start, nodeNames);
        } else {
            all.push_back({start, kind.meaning});
        }
    }
    return all;
}

Candidates users(Typed const&, std::string const&, NodeNames const& nodeNames)
{
    return names(*kindAt("user:"), "", nodeNames);
}

Candidates groups(Typed const&, std::string const&, NodeNames const& nodeNames)
{
    return names(*kindAt("group:"), "", nodeNames);
}

Candidates properties(Typed const& typed, std::string const&, NodeNames const&)
{
    return propertiesOf(kindAt(typed.arguments.at(0)));
}

Candidates values(Typed const& typed, std::string const&, NodeNames const&)
{
    NodeKind const* const kind = kindAt(typed.arguments.at(0));
    Property const* const property = kind ? findProperty(*kind, typed.arguments.at(1)) : nullptr;
    if (property && property->has(Property::Secret))
        return {{toBeAsked, "read from a prompt"}};
    if (property && property->kind == IC::PropertyValue::BooleanKind)
        return {{"true", ""}, {"false", ""}};
    return {};
}

Candidates methodNames(Typed const&, std::string const&, NodeNames const&)
{
    Candidates all;
    for (Method const& method : methods())
        all.push_back({method.name, method.meaning});
    return all;
}

struct NamingParameter {
    char const* parameter;
    char const* address;
};

constexpr NamingParameter namingParameters[] = {
    {IC::parameter::userName, "user:"},
    {IC::parameter::domainAndMember, "user:"},
    {IC::parameter::groupName, "group:"},
    {IC::parameter::localGroupName, "group:"},
};

/** The kind of node that a parameter's value names; null if it names none, or a new one. */
NodeKind const* namedKind(Method const& method, std::string const& parameter)
{
    constexpr std::string_view adds = "Add";
    std::string_view const name = method.name;
    if (name.substr(name.size() - adds.size()) == adds)
        return nullptr;
    for (NamingParameter const& naming : namingParameters)
        if (naming.parameter == parameter)
            return kindAt(naming.address);
    return nullptr;
}

bool isGiven(std::vector<std::string> const& arguments, std::string const& parameter)
{
    return std::any_of(arguments.begin(), arguments.end(), [&parameter](std::string const& each) {
        return beginsWith(each, parameter + '=');
    });
}

Candidates parameters(Typed const& typed, std::string const& word, NodeNames const& nodeNames)
{
    Method const* const method = findMethod(typed.arguments.at(0));
    if (!method)
        return {};
    if (std::size_t const equals = word.find('='); equals != std::string::npos) {
        NodeKind const* const kind = namedKind(*method, word.substr(0, equals));
        return kind ? names(*kind, word.substr(0, equals + 1), nodeNames) : Candidates();
    }
    Candidates all;
    for (Parameter const& parameter : method->parameters)
        if (!isGiven(typed.arguments, parameter.name)) // a password should be prompted for
            all.push_back({fmt::format("{}={}", parameter.name,
                                       parameter.form == Form::Password ? toBeAsked : ""),
                           parameter.meaning});
    return all;
}

Candidates commandsOf(CLI::App const& app)
{
    Candidates all;
    for (CLI::App const* command : app.get_subcommands({}))
        all.push_back({command->get_name(), command->get_description()});
    return all;
}

/** The commands that have help. */
Candidates commandsOfHelp(Typed const& typed, std::string const&, NodeNames const&)
{
    CLI::App* app = typed.program;
    for (std::string const& word : typed.arguments)
        app = app ? findCommand(*app, word) : nullptr;
    return app ? commandsOf(*app) : Candidates();
}

/** Properties of the kind that is listed, the last of them being typed. */
Candidates columns(Typed const& typed, std::string const& word, NodeNames const&)
{
    Candidates all = propertiesOf(typed.arguments.empty() ? nullptr : findList(typed.arguments[0]));
    for (Candidate& candidate : all)
        candidate.word.insert(0, word, 0, word.rfind(',') + 1);
    return all;
}

/** The column of --where up to its sign; the value is free. */
Candidates conditions(Typed const& typed, std::string const& word, NodeNames const&)
{
    Candidates all = columns(typed, "", {});
    for (Candidate& candidate : all)
        candidate.word += '=';
    return word.find_first_of("=~") == std::string::npos ? all : Candidates();
}

/** A column of --sort, with the sign for descending if that is typed. */
Candidates sortColumns(Typed const& typed, std::string const& word, NodeNames const&)
{
    Candidates all = columns(typed, "", {});
    for (Candidate& candidate : all)
        candidate.word.insert(0, word, 0, beginsWith(word, "-") ? 1 : 0);
    return all;
}

struct Place {
    char const* name; // of the argument or option in the help text
    Candidates (*candidates)(Typed const& typed, std::string const& word,
                             NodeNames const& nodeNames);
};

constexpr Place places[] = {
    {"NODE", nodes},         {"PROPERTY", properties},  {"VALUE", values},
    {"METHOD", methodNames}, {"PARAMETER", parameters}, {"--columns", columns},
    {"--where", conditions}, {"--sort", sortColumns},   {"COMMAND", commandsOfHelp},
    {"USER", users},         {"GROUP", groups},
};

/** The words of an option that takes one of a few. */
Candidates choices(CommandLine const& line, CLI::Option const& option)
{
    Candidates all;
    if (Choices const* const words = line.choicesOf(option))
        for (std::string const& word : *words)
            all.push_back({word, ""});
    return all;
}

Completion completeValue(Typed const& typed, CLI::Option const& option, std::string const& word,
                         NodeNames const& nodeNames)
{
    if (option.get_type_name() == "FILE")
        return {Completion::What::Files, {}};
    if (option.get_type_name() == "DIR")
        return {Completion::What::Folders, {}};
    std::string const name = option.get_name();
    for (Place const& place : places)
        if (place.name == name)
            return {Completion::What::Words, place.candidates(typed, word, nodeNames)};
    return {Completion::What::Words, choices(*typed.line, option)};
}

/** An option's value after its equals sign. */
Completion completeAssignment(Typed const& typed, std::string const& word,
                              NodeNames const& nodeNames)
{
    std::size_t const equals = word.find('=');
    CLI::Option const* const option = findOption(typed, word.substr(0, equals));
    if (!option || option->get_items_expected_max() == 0)
        return {};
    Completion completion = completeValue(typed, *option, word.substr(equals + 1), nodeNames);
    for (Candidate& candidate : completion.candidates)
        candidate.word.insert(0, word, 0, equals + 1);
    return completion;
}

bool holds(Candidates const& all, std::string const& word)
{
    return std::any_of(all.begin(), all.end(),
                       [&word](Candidate const& each) { return each.word == word; });
}

void addOptions(CLI::App const& app, Candidates& all)
{
    for (CLI::Option const* option : app.get_options())
        for (std::string const& name : option->get_lnames())
            if (std::string const word = "--" + name; !holds(all, word))
                all.push_back({word, option->get_description()});
}

Completion completeOption(Typed const& typed)
{
    Completion completion;
    for (CLI::App const* app = typed.command; app; app = app->get_parent())
        addOptions(*app, completion.candidates);
    return completion;
}

Completion completeArgument(Typed const& typed, std::string const& word, NodeNames const& nodeNames)
{
    auto const taken = [](CLI::Option const* option) { return option->get_positional(); };
    std::vector<CLI::Option const*> const positionals =
        std::as_const(*typed.command).get_options(taken);
    std::size_t before = typed.arguments.size();
    for (CLI::Option const* positional : positionals) {
        auto const most = static_cast<std::size_t>(positional->get_items_expected_max());
        if (before < most)
            return completeValue(typed, *positional, word, nodeNames);
        before -= most;
    }
    return {};
}

Completion anything(Typed const& typed, std::string const& word, NodeNames const& nodeNames)
{
    if (typed.isWrong)
        return {};
    if (typed.waiting)
        return completeValue(typed, *typed.waiting, word, nodeNames);
    if (looksLikeOption(typed, word) || (word == "-" && !typed.onlyArguments))
        return word.find('=') == std::string::npos ? completeOption(typed)
                                                   : completeAssignment(typed, word, nodeNames);
    Completion completion = completeArgument(typed, word, nodeNames);
    if (mayNameCommand(typed))
        for (Candidate const& command : commandsOf(*typed.command))
            completion.candidates.push_back(command);
    return completion;
}

} // namespace

Completion complete(std::vector<std::string> const& words, NodeNames const& names,
                    CommandTable const& table, CommandLine::Place place)
{
    CommandLine line(table, place);
    CLI::App program;
    line.declare(program);
    Typed typed(line, program);
    for (std::size_t at = 0; at + 1 < words.size(); ++at)
        take(typed, words[at]);
    std::string const word = words.empty() ? "" : words.back();
    Completion completion = anything(typed, word, names);
    auto& all = completion.candidates;
    all.erase(std::remove_if(all.begin(), all.end(),
                             [&word](Candidate const& candidate) {
                                 return !beginsWith(candidate.word, word);
                             }),
              all.end());
    return completion;
}

std::string completionText(Completion const& completion)
{
    switch (completion.what) {
    case Completion::What::Files:
        return "files\n";
    case Completion::What::Folders:
        return "folders\n";
    case Completion::What::Words:
        break;
    }
    std::string text = "words\n";
    for (Candidate const& candidate : completion.candidates)
        text += candidate.word + (candidate.note.empty() ? "" : '\t' + candidate.note) + '\n';
    return text;
}

} // namespace mihost
