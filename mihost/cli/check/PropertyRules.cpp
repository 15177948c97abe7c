#include "mihost/cli/check/PropertyRules.h"

#include "host/Properties.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>
#include <limits>
#include <map>
#include <set>

namespace mihost::checks
{

namespace
{

using Values = std::map<unsigned int, IC::PropertyValue>;

struct Place {
    unsigned int type;
    unsigned int property;

    bool operator==(Place const& other) const
    {
        return type == other.type && property == other.property;
    }
};

// Unset if the system does not say. So are most of the operating system's; see neverMissing.
constexpr Place mayBeMissing[] = {
    {IC::nodeType::computer, IC::property::name},
    {IC::nodeType::logEntry, IC::property::message},
    {IC::nodeType::logEntry, IC::property::creationTime},
};

constexpr unsigned int neverMissing[] = {
    IC::property::fixedEnumeration, IC::property::requestedState, IC::property::fixedNumbers,
    IC::property::createUser,       IC::property::refresh,
};

struct FixedValue {
    Place place;
    char const* text;
};

constexpr char fixedNumbers[] = "0,1,24";

constexpr FixedValue fixedValues[] = {
    {{IC::nodeType::operatingSystem, IC::property::fixedEnumeration}, "35"},
    {{IC::nodeType::operatingSystem, IC::property::requestedState}, "1"},
    {{IC::nodeType::operatingSystem, IC::property::fixedNumbers}, fixedNumbers},
    {{IC::nodeType::operatingSystem, IC::property::createUser}, "dummy"},
    {{IC::nodeType::operatingSystem, IC::property::refresh}, "1"},
    {{IC::nodeType::driver, IC::property::buildNumber}, ""},
    {{IC::nodeType::driver, IC::property::manufacturer}, ""},
    {{IC::nodeType::user, IC::property::requestedState}, "1"},
    {{IC::nodeType::user, IC::property::fixedNumbers}, fixedNumbers},
    {{IC::nodeType::user, IC::property::reservedText}, ""},
    {{IC::nodeType::user, IC::property::deleteUser}, "false"},
    {{IC::nodeType::log, IC::property::requestedState}, "1"},
    {{IC::nodeType::log, IC::property::fixedNumbers}, fixedNumbers},
    {{IC::nodeType::log, IC::property::logNumber}, "0"},
    {{IC::nodeType::log, IC::property::name}, "OS Log"},
    {{IC::nodeType::log, IC::property::logState}, "2"},
    {{IC::nodeType::log, IC::property::dataType}, "*string LogData*"},
};

struct LengthRule {
    unsigned int length; // the property that holds the length
    unsigned int of;     // of this text
};

constexpr LengthRule userLengths[] = {
    {IC::property::nameLength, IC::property::name},
    {IC::property::idLength, IC::property::id},
    {IC::property::passwordLength, IC::property::password},
};

bool isRequired(NodeKind const& kind, Property const& property)
{
    if (property.has(Property::Unstored))
        return false;
    if (kind.type == IC::nodeType::operatingSystem)
        return std::find(std::begin(neverMissing), std::end(neverMissing), property.id) !=
               std::end(neverMissing);
    return std::find(std::begin(mayBeMissing), std::end(mayBeMissing),
                     Place{kind.type, property.id}) == std::end(mayBeMissing);
}

/** A figure that could not be read while the tree was built has the previous value, or none. */
bool isKind(Property const& property, IC::PropertyValue const& value)
{
    return value.getKind() == property.kind ||
           (property.has(Property::Live) && value.getKind() == ValueKind::EmptyKind);
}

std::string nameOfProperty(IC::MutableNode const& node, Property const& property)
{
    return fmt::format("{}: {} ({})", nameOf(node), property.name, property.id);
}

/** Checks each stored value of a known property. */
template <class Look> void forEachValue(Nodes const& nodes, Look look)
{
    for (IC::MutableNode const* node : nodes) {
        NodeKind const* const kind = findKind(node->getNodeType());
        if (!kind)
            continue;
        for (auto const& [id, value] : node->getProperties())
            if (Property const* const property = findProperty(*kind, id))
                look(*node, *property, value);
    }
}

std::string textOf(Values const& values, unsigned int id)
{
    auto const found = values.find(id);
    return found == values.end() ? "" : static_cast<std::string>(found->second);
}

void expectText(Findings& findings, IC::MutableNode const& node, unsigned int id,
                std::string const& expected)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    Property const* const property = findProperty(*kind, id);
    std::string const found = textOf(node.getProperties(), id);
    if (found != expected)
        findings.push_back(fmt::format("{}: '{}' rather than '{}'", nameOfProperty(node, *property),
                                       found, expected));
}

void checkRead(Findings& findings, IC::MutableNode const& node, Property const& property,
               bool stored)
{
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    bool const answered = node.getProperty(property.id, value).getStatus() == 0;
    bool const expected = stored || property.has(Property::Unstored);
    if (expected && !answered)
        findings.push_back(fmt::format("{}: cannot be read", nameOfProperty(node, property)));
    else if (answered && !isKind(property, value))
        findings.push_back(
            fmt::format("{}: reads as {} rather than {}", nameOfProperty(node, property),
                        valueKindName(value.getKind()), valueKindName(property.kind)));
}

} // namespace

Findings wrongPropertyIds(Nodes const& nodes)
{
    Findings findings;
    for (IC::MutableNode const* node : nodes) {
        NodeKind const* const kind = findKind(node->getNodeType());
        if (!kind)
            continue;
        Values const values = node->getProperties();
        for (Property const& property : kind->properties)
            if (isRequired(*kind, property) && values.count(property.id) == 0)
                findings.push_back(fmt::format("{}: not set", nameOfProperty(*node, property)));
        for (auto const& [id, value] : values)
            if (!findProperty(*kind, id))
                findings.push_back(fmt::format("{}: unknown property {}", nameOf(*node), id));
    }
    return findings;
}

Findings wrongKinds(Nodes const& nodes)
{
    Findings findings;
    forEachValue(nodes, [&findings](IC::MutableNode const& node, Property const& property,
                                    IC::PropertyValue const& value) {
        if (!isKind(property, value))
            findings.push_back(fmt::format("{}: {} rather than {}", nameOfProperty(node, property),
                                           valueKindName(value.getKind()),
                                           valueKindName(property.kind)));
    });
    return findings;
}

Findings wrongFlags(Nodes const& nodes)
{
    // Contract: the one value with a false flag.
    constexpr Place withoutFlag{IC::nodeType::operatingSystem, IC::property::requestedState};
    Findings findings;
    forEachValue(nodes, [&](IC::MutableNode const& node, Property const& property,
                            IC::PropertyValue const& value) {
        bool const expected = !(Place{node.getNodeType(), property.id} == withoutFlag);
        if (value.getFlag() != expected)
            findings.push_back(fmt::format("{}: flag {} rather than {}",
                                           nameOfProperty(node, property), value.getFlag(),
                                           expected));
    });
    return findings;
}

Findings wrongValues(Nodes const& nodes)
{
    Findings findings;
    std::map<unsigned int, unsigned int> counts;
    for (IC::MutableNode const* node : nodes)
        ++counts[node->getNodeType()];
    for (IC::MutableNode const* node : nodes) {
        unsigned int const type = node->getNodeType();
        for (FixedValue const& fixed : fixedValues)
            if (fixed.place.type == type)
                expectText(findings, *node, fixed.place.property, fixed.text);
        Values const values = node->getProperties();
        if (type == IC::nodeType::user)
            for (LengthRule const& rule : userLengths)
                expectText(findings, *node, rule.length,
                           std::to_string(textOf(values, rule.of).size()));
        if (type == IC::nodeType::user || type == IC::nodeType::group)
            expectText(findings, *node, IC::property::elementCount, std::to_string(counts[type]));
        if (type == IC::nodeType::logEntry)
            expectText(findings, *node, IC::property::id, std::to_string(node->getIndex()));
    }
    return findings;
}

Findings wrongReads(Nodes const& nodes)
{
    constexpr unsigned int unknown = std::numeric_limits<unsigned int>::max();
    Findings findings;
    std::set<unsigned int> seen;
    for (IC::MutableNode const* node : nodes) {
        NodeKind const* const kind = findKind(node->getNodeType());
        if (!kind || !seen.insert(kind->type).second)
            continue;
        Values const values = node->getProperties();
        for (Property const& property : kind->properties)
            checkRead(findings, *node, property, values.count(property.id) != 0);
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        if (node->getProperty(unknown, value).getStatus() == 0)
            findings.push_back(fmt::format("{}: returns a value for the unknown property {}",
                                           nameOf(*node), unknown));
    }
    return findings;
}

} // namespace mihost::checks
