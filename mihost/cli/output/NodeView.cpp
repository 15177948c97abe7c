#include "mihost/cli/output/NodeView.h"

#include "mihost/cli/accounts/ShadowGap.h"
#include "mihost/cli/input/Address.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"

#include <fmt/format.h>
#include <set>

namespace mihost
{

namespace
{

bool isHidden(Property const* row, IC::PropertyValue const& value, Secrets secrets)
{
    if (!row)
        return false;
    if (row->has(Property::Secret))
        return secrets == Secrets::Hide;
    // A plain password is never shown.
    return row->has(Property::MayBeSecret) &&
           static_cast<std::string>(value).find("Password") != std::string::npos;
}

PropertyView view(NodeKind const* kind, unsigned int id, IC::PropertyValue const& value,
                  Secrets secrets, ShadowGap const& gap)
{
    Property const* const row = kind ? findProperty(*kind, id) : nullptr;
    return {id, row, value, isHidden(row, value, secrets), gap.reasonFor(id, value)};
}

IC::PropertyValue emptyValue()
{
    return {IC::PropertyValue::EmptyKind, true};
}

/** The ids that a node stores or answers live, ascending. */
std::set<unsigned int> idsOf(IC::MutableNode const& node)
{
    std::set<unsigned int> ids;
    for (auto const& [id, value] : node.getProperties())
        ids.insert(id);
    if (NodeKind const* const kind = findKind(node.getNodeType()))
        for (Property const& row : kind->properties)
            if (row.has(Property::Live))
                ids.insert(row.id);
    return ids;
}

/** Adds the property's present value if the node returns one. */
void addLive(NodeView& to, unsigned int id, Secrets secrets, ShadowGap const& gap)
{
    IC::PropertyValue value = emptyValue();
    if (to.node->getProperty(id, value).getStatus() == 0)
        to.properties.push_back(view(findKind(to.node->getNodeType()), id, value, secrets, gap));
}

} // namespace

NodeView storedView(IC::MutableNode const& node, Secrets secrets)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    auto const stored = node.getProperties();
    ShadowGap const gap(node);
    NodeView result{&node, {}};
    for (unsigned int const id : idsOf(node)) {
        auto const found = stored.find(id);
        if (found != stored.end())
            result.properties.push_back(view(kind, id, found->second, secrets, gap));
        else
            addLive(result, id, secrets, gap);
    }
    return result;
}

NodeView liveView(IC::MutableNode const& node, Secrets secrets)
{
    ShadowGap const gap(node);
    NodeView result{&node, {}};
    for (unsigned int const id : idsOf(node))
        addLive(result, id, secrets, gap);
    return result;
}

NodeView liveView(IC::MutableNode const& node, std::vector<std::string> const& names,
                  Secrets secrets)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    ShadowGap const gap(node);
    NodeView result{&node, {}};
    for (std::string const& name : names) {
        unsigned int const id = propertyId(node, name);
        IC::PropertyValue value = emptyValue();
        IC::Error const error = node.getProperty(id, value);
        if (error.getStatus() != 0)
            throw Failure(Failed,
                          fmt::format("property '{}' of node '{}': {} (see 'mihost doctor')", name,
                                      addressOf(node), static_cast<std::string>(error)));
        result.properties.push_back(view(kind, id, value, secrets, gap));
    }
    return result;
}

unsigned int propertyId(IC::MutableNode const& node, std::string const& name)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    if (Property const* const row = kind ? findProperty(*kind, name) : nullptr)
        return row->id;
    if (auto const id = parseDecimal(name);
        id && ((kind && findProperty(*kind, *id)) || node.getProperties().count(*id) != 0))
        return *id;
    std::vector<std::string> known;
    for (unsigned int const each : idsOf(node)) {
        Property const* const row = kind ? findProperty(*kind, each) : nullptr;
        known.push_back(row ? row->name : std::to_string(each));
    }
    throw Failure(NotFound, fmt::format("node '{}' has no property '{}' ({})", addressOf(node),
                                        name, suggestion(name, known, "it has")));
}

std::string valueText(PropertyView const& property)
{
    if (!property.unknown.empty())
        return "-";
    return property.hidden ? "(hidden)" : static_cast<std::string>(property.value);
}

Cell cellOf(PropertyView const& property)
{
    bool const isShown = property.unknown.empty() && !property.hidden;
    Cell cell(isShown ? valueToJson(property.value) : Json(nullptr), valueText(property));
    cell.unknown = property.unknown;
    return cell;
}

std::string nameOf(PropertyView const& property)
{
    return property.row ? property.row->name : std::to_string(property.id);
}

} // namespace mihost
