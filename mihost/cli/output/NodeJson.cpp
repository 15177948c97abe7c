#include "mihost/cli/output/NodeJson.h"

#include "mihost/cli/output/UnknownValues.h"

namespace mihost
{

Json toJson(PropertyView const& property)
{
    Json object;
    object["id"] = property.id;
    object["kind"] = valueKindName(property.value.getKind());
    object["flag"] = property.value.getFlag();
    bool const isUnknown = !property.unknown.empty();
    noteUnknown(property.unknown);
    object["value"] = isUnknown || property.hidden ? Json(nullptr) : valueToJson(property.value);
    if (isUnknown)
        object["unknown"] = toJson(property.unknown);
    else if (property.hidden)
        object["hidden"] = true;
    return object;
}

Json toJson(NodeView const& view)
{
    IC::MutableNode const& node = *view.node;
    Json object;
    object["id"] = node.getNodeId();
    object["parent"] = node.getLinkedId();
    object["type"] = node.getNodeType();
    object["kind"] = kindName(node.getNodeType());
    object["index"] = node.getIndex();
    object["status"] = node.getStatus();
    object["description"] = toJson(node.getDescription());
    object["mi_ids"] = node.getMIIds();
    Json properties = Json::object();
    for (PropertyView const& property : view.properties)
        properties[nameOf(property)] = toJson(property);
    object["properties"] = properties;
    return object;
}

} // namespace mihost
