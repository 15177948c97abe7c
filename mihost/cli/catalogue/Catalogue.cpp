#include "mihost/cli/catalogue/Catalogue.h"

#include <algorithm>
#include <cstring>

namespace mihost
{

namespace
{

template <class Rows, class Matches> auto const* find(Rows const& rows, Matches matches)
{
    auto const found = std::find_if(rows.begin(), rows.end(), matches);
    return found == rows.end() ? nullptr : &*found;
}

} // namespace

NodeKind const* findKind(unsigned int nodeType)
{
    return find(nodeKinds(), [nodeType](NodeKind const& kind) { return kind.type == nodeType; });
}

NodeKind const* findList(std::string_view name)
{
    return find(nodeKinds(),
                [name](NodeKind const& kind) { return !name.empty() && kind.listName == name; });
}

Property const* findProperty(NodeKind const& kind, unsigned int id)
{
    return find(kind.properties, [id](Property const& property) { return property.id == id; });
}

Property const* findProperty(NodeKind const& kind, std::string_view name)
{
    return find(kind.properties,
                [name](Property const& property) { return property.name == name; });
}

Method const* findMethod(std::string_view name)
{
    return find(methods(), [name](Method const& method) { return method.name == name; });
}

Parameter const* findParameter(Method const& method, std::string_view name)
{
    return find(method.parameters,
                [name](Parameter const& parameter) { return parameter.name == name; });
}

char const* kindName(unsigned int nodeType)
{
    NodeKind const* kind = findKind(nodeType);
    return kind ? kind->name : "unknown";
}

char const* valueKindName(ValueKind kind)
{
    static constexpr char const* names[] = {"empty", "text",        "number",  "boolean",
                                            "date",  "enumeration", "numbers", "texts"};
    return names[kind];
}

} // namespace mihost
