#ifndef MIHOST_CLI_CATALOGUE_CATALOGUE_H
#define MIHOST_CLI_CATALOGUE_CATALOGUE_H

#include "host/PropertyValue.h"

#include <string>
#include <string_view>
#include <vector>

/**
 * What the plug-in's tree consists of: kinds of nodes, their properties, and the methods of the
 * operating-system node. Names, help, checks, completion and the reference documents come from
 * here.
 */
namespace mihost
{

using ValueKind = IC::PropertyValue::KindType;

/** The form that a text must have before it is passed to the plug-in. */
enum class Form {
    Free,        // anything; the plug-in only stores it
    AccountName, // the name of a user or group
    PlainName,   // such a name that no tool reads as an id or a path
    Digits,      // an id or a count
    Path,        // an absolute path
    Words,       // text with single blanks in it
    Password,    // a plain password
    Hash,        // a password hash as in the shadow file
    Day,         // a day, YYYY-MM-DD
    MethodCall   // a method-call text
};

struct Property {
    enum Traits : unsigned {
        Plain = 0,
        Live = 1,        // gathered at the moment of the read
        Unstored = 2,    // answers only live: nothing is stored
        Acts = 4,        // a write changes the system
        Secret = 8,      // shown only on demand
        MayBeSecret = 16 // shown unless it holds a password
    };

    unsigned int id;
    char const* name;
    ValueKind kind;
    char const* unit; // "" for none
    unsigned int traits;
    Form form;
    char const* meaning;

    bool has(Traits trait) const
    {
        return (traits & trait) != 0;
    }
};

struct NodeKind {
    unsigned int type;
    char const* name;          // as in JSON
    char const* address;       // how a node of this kind is written: "os", or "user" of user:NAME
    bool single;               // there is one node of this kind
    char const* listName;      // what the list command calls it; "" for single nodes
    unsigned int nameProperty; // what follows the colon in an address; 0 for none
    unsigned int headline;     // the most telling property, shown next to a node; 0 for none
    char const* meaning;
    std::vector<std::string> columns; // of its table if none are chosen
    std::vector<Property> properties; // in the order in which the plug-in sets them
};

struct Parameter {
    char const* name;
    char const* type; // as in a method-call text
    Form form;
    bool required;
    char const* meaning;
};

struct Method {
    char const* name;
    char const* meaning;
    std::vector<Parameter> parameters;
};

std::vector<NodeKind> const& nodeKinds();
std::vector<Method> const& methods();

/** The names of kinds, properties, methods or parameters, in their order. */
template <class Rows> std::vector<std::string> rowNames(Rows const& rows)
{
    std::vector<std::string> names;
    names.reserve(rows.size());
    for (auto const& row : rows)
        names.emplace_back(row.name);
    return names;
}

NodeKind const* findKind(unsigned int nodeType);

/** The kind with this name in the list command; null if there is none. */
NodeKind const* findList(std::string_view name);

Property const* findProperty(NodeKind const& kind, unsigned int id);
Property const* findProperty(NodeKind const& kind, std::string_view name);
Method const* findMethod(std::string_view name);
Parameter const* findParameter(Method const& method, std::string_view name);

/** @return the name of a node's kind as in JSON; "unknown" for a type that no kind has */
char const* kindName(unsigned int nodeType);

/** @return the name of a value's kind, such as "text" */
char const* valueKindName(ValueKind kind);

} // namespace mihost

#endif
