#include "mihost/cli/output/CatalogueText.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <utility>

namespace mihost
{

namespace
{

std::string addressForm(NodeKind const& kind)
{
    return kind.single ? kind.address : fmt::format("{}:NAME", kind.address);
}

/** The title, and the table below it, which may have no rows. */
std::vector<std::string> titled(std::string const& title, Table const& table, Room const& room)
{
    constexpr std::size_t indent = 2;
    std::vector<std::string> lines = {title};
    if (!table.rows().empty())
        for (std::string const& line : layOut(table, room.indented(indent)))
            lines.push_back(std::string(indent, ' ') + line);
    return lines;
}

} // namespace

std::vector<std::string> kindLines(NodeKind const& kind, Room const& room)
{
    Selection withoutKind;
    withoutKind.columns = {"id", "name", "type", "traits", "meaning"};
    return titled(
        fmt::format("{} (type {}, {}): {}", kind.name, kind.type, addressForm(kind), kind.meaning),
        propertiesTable({&kind}).selected(withoutKind), room);
}

std::vector<std::string> methodLines(Method const& method, Room const& room)
{
    return titled(fmt::format("{}: {}", method.name, method.meaning), parametersTable(method),
                  room);
}

Table propertiesTable(std::vector<NodeKind const*> const& kinds)
{
    Table table(
        {{"kind"}, {"id", Column::Align::Right}, {"name"}, {"type"}, {"traits"}, {"meaning"}});
    for (NodeKind const* kind : kinds)
        for (Property const& property : kind->properties)
            table.add({kind->name, Cell(property.id, std::to_string(property.id)), property.name,
                       typeText(property), traitsText(property), property.meaning});
    return table;
}

Table methodsTable()
{
    Table table({{"method"}, {"meaning"}});
    for (Method const& method : methods())
        table.add({method.name, method.meaning});
    return table;
}

Table parametersTable(Method const& method)
{
    Table table({{"parameter"}, {"value"}, {"required"}, {"meaning"}});
    for (Parameter const& parameter : method.parameters)
        table.add({parameter.name, formName(parameter.form),
                   Cell(parameter.required, parameter.required ? "required" : ""),
                   parameter.meaning});
    return table;
}

Json toJson(NodeKind const& kind)
{
    Json properties = Json::array();
    for (Property const& property : kind.properties)
        properties.push_back({{"id", property.id},
                              {"name", property.name},
                              {"kind", valueKindName(property.kind)},
                              {"unit", property.unit},
                              {"live", property.has(Property::Live)},
                              {"acts", property.has(Property::Acts)},
                              {"secret", property.has(Property::Secret)},
                              {"meaning", property.meaning}});
    return {{"kind", kind.name},
            {"type", kind.type},
            {"address", addressForm(kind)},
            {"meaning", kind.meaning},
            {"properties", properties}};
}

Json toJson(Method const& method)
{
    Json parameters = Json::array();
    for (Parameter const& parameter : method.parameters)
        parameters.push_back({{"name", parameter.name},
                              {"type", parameter.type},
                              {"value", formName(parameter.form)},
                              {"required", parameter.required},
                              {"meaning", parameter.meaning}});
    return {{"method", method.name}, {"meaning", method.meaning}, {"parameters", parameters}};
}

std::string propertiesDocument()
{
    std::string text = "# Nodes and properties\n\n"
                       "Made by `mihost properties --markdown`.\n\n"
                       "Each node has a type and numbered properties. *Live* is gathered at the "
                       "moment of the read;\neverything else is what was stored when the node was "
                       "built. *Acts*: writing it changes the system;\nother writes are stored in "
                       "the node and change nothing. *Secret*: shown with `--show-secrets` only.\n";
    for (NodeKind const& kind : nodeKinds()) {
        text += fmt::format("\n## {}\n\nType {}, addressed as `{}`: {}.\n", kind.name, kind.type,
                            addressForm(kind), kind.meaning);
        if (kind.properties.empty())
            continue;
        text += "\n| Id | Name | Kind | | Meaning |\n|---|---|---|---|---|\n";
        for (Property const& property : kind.properties)
            text += fmt::format("| {} | `{}` | {} | {} | {} |\n", property.id, property.name,
                                typeText(property), traitsText(property), property.meaning);
    }
    return text;
}

std::string methodsDocument()
{
    std::string text =
        "# Administration methods\n\n"
        "Made by `mihost methods --markdown`.\n\n"
        "`mihost call METHOD NAME=VALUE...` checks the values, builds the method-call text and "
        "writes it to\nproperty 74 of the operating-system node. A host that writes the text "
        "itself "
        "writes the method's name\nand then, after a comma each, name, type and value with colons "
        "between them; see\n[security.md](security.md) for what it has to check first.\n";
    for (Method const& method : methods()) {
        text += fmt::format("\n## {}\n\n{}.\n", method.name, method.meaning);
        if (method.parameters.empty())
            continue;
        text += "\n| Parameter | Type | Value | | Meaning |\n|---|---|---|---|---|\n";
        for (Parameter const& parameter : method.parameters)
            text += fmt::format("| `{}` | {} | {} | {} | {} |\n", parameter.name, parameter.type,
                                formName(parameter.form), parameter.required ? "required" : "",
                                parameter.meaning);
    }
    return text;
}

std::string typeText(Property const& property)
{
    return *property.unit ? fmt::format("{}, {}", valueKindName(property.kind), property.unit)
                          : valueKindName(property.kind);
}

std::string traitsText(Property const& property)
{
    static constexpr std::pair<Property::Traits, char const*> names[] = {
        {Property::Live, "live"}, {Property::Acts, "acts"}, {Property::Secret, "secret"}};
    std::vector<std::string> words;
    for (auto const& [trait, name] : names)
        if (property.has(trait))
            words.emplace_back(name);
    return fmt::format("{}", fmt::join(words, ", "));
}

char const* formName(Form form)
{
    switch (form) {
    case Form::AccountName:
    case Form::PlainName:
        return "name";
    case Form::Digits:
        return "number";
    case Form::Path:
        return "absolute path";
    case Form::Password:
        return "password";
    case Form::Hash:
        return "password hash";
    case Form::Day:
        return "YYYY-MM-DD";
    case Form::MethodCall:
        return "method-call text";
    case Form::Free:
    case Form::Words:
        break;
    }
    return "text";
}

} // namespace mihost
