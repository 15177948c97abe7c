#include "mihost/cli/output/Json.h"

#include "mihost/runtime/Text.h"

namespace mihost
{

namespace
{

Json valueToJson(IC::PropertyValue const& value)
{
    switch (value.getKind()) {
    case IC::PropertyValue::TextKind:
        return toJson(static_cast<std::string>(value));
    case IC::PropertyValue::BooleanKind:
        return value.getNumber() != 0;
    case IC::PropertyValue::NumberKind:
    case IC::PropertyValue::DateKind:
    case IC::PropertyValue::EnumerationKind:
        return value.getNumber();
    case IC::PropertyValue::NumbersKind: {
        Json list = Json::array();
        for (IC::Number const& number : value.getNumbers())
            list.push_back(number.getValue());
        return list;
    }
    case IC::PropertyValue::TextsKind: {
        Json list = Json::array();
        for (std::string const& text : value.getTexts())
            list.push_back(toJson(text));
        return list;
    }
    case IC::PropertyValue::EmptyKind:
        break;
    }
    return nullptr;
}

} // namespace

Json toJson(std::string const& text)
{
    return validUtf8(text);
}

Json toJson(PropertyView const& property)
{
    Json object;
    object["name"] = property.row ? Json(property.row->name) : Json(nullptr);
    object["kind"] = valueKindName(property.value.getKind());
    object["flag"] = property.value.getFlag();
    bool const isUnknown = !property.unknown.empty();
    noteUnknown(property);
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
        properties[std::to_string(property.id)] = toJson(property);
    object["properties"] = properties;
    return object;
}

} // namespace mihost
