#ifndef MIHOST_CLI_CATALOGUE_CATALOGUEROWS_H
#define MIHOST_CLI_CATALOGUE_CATALOGUEROWS_H

#include "host/Methods.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <utility>

/** How the catalogue's tables are written: each field of a row goes by its name. */
namespace mihost::rows
{

struct PropertyRow : Property {
    /** The unit of the value. */
    PropertyRow in(char const* ofValue) const
    {
        return with(&PropertyRow::unit, ofValue);
    }
    PropertyRow live() const
    {
        return with(Live);
    }
    PropertyRow unstored() const
    {
        return with(Unstored);
    }
    PropertyRow acts() const
    {
        return with(Acts);
    }
    PropertyRow secret() const
    {
        return with(Secret);
    }
    PropertyRow mayBeSecret() const
    {
        return with(MayBeSecret);
    }
    PropertyRow takes(Form ofValue) const
    {
        return with(&PropertyRow::form, ofValue);
    }

private:
    template <class Field, class Value> PropertyRow with(Field Property::*field, Value value) const
    {
        PropertyRow row = *this;
        row.*field = value;
        return row;
    }
    PropertyRow with(Traits more) const
    {
        return with(&PropertyRow::traits, traits | more);
    }
};

constexpr PropertyRow property(unsigned int id, char const* name, ValueKind kind, Form form,
                               char const* meaning)
{
    return {{id, name, kind, "", Property::Plain, form, meaning}};
}

constexpr PropertyRow text(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::TextKind, Form::Free, meaning);
}

constexpr PropertyRow texts(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::TextsKind, Form::Free, meaning);
}

constexpr PropertyRow number(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::NumberKind, Form::Digits, meaning);
}

constexpr PropertyRow numbers(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::NumbersKind, Form::Digits, meaning);
}

constexpr PropertyRow enumeration(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::EnumerationKind, Form::Digits, meaning);
}

constexpr PropertyRow boolean(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::BooleanKind, Form::Free, meaning);
}

constexpr PropertyRow date(unsigned int id, char const* name, char const* meaning)
{
    return property(id, name, IC::PropertyValue::DateKind, Form::Day, meaning);
}

struct KindRow : NodeKind {
    KindRow addressedAs(char const* word) const
    {
        KindRow row = *this;
        row.address = word;
        return row;
    }
    KindRow showing(unsigned int property) const
    {
        KindRow row = *this;
        row.headline = property;
        return row;
    }
    KindRow listedAs(char const* word, std::vector<std::string> usualColumns) const
    {
        KindRow row = *this;
        row.listName = word;
        row.columns = std::move(usualColumns);
        return row;
    }
    KindRow having(std::vector<Property> all) const
    {
        KindRow row = *this;
        row.properties = std::move(all);
        return row;
    }
};

/** A kind of which there is one node. It is addressed by the kind's name. */
inline KindRow one(unsigned int type, char const* name, char const* meaning)
{
    return {{type, name, name, true, "", 0, 0, meaning, {}, {}}};
}

/** A kind with several nodes, distinguished by a property. */
inline KindRow several(unsigned int type, char const* name, unsigned int nameProperty,
                       char const* meaning)
{
    return {{type, name, name, false, "", nameProperty, 0, meaning, {}, {}}};
}

constexpr char const* typeOf(Form form)
{
    switch (form) {
    case Form::Digits:
        return IC::parameterType::number;
    case Form::Day:
        return IC::parameterType::date;
    default:
        return IC::parameterType::text;
    }
}

constexpr Parameter required(char const* name, Form form, char const* meaning)
{
    return {name, typeOf(form), form, true, meaning};
}

constexpr Parameter optional(char const* name, Form form, char const* meaning)
{
    return {name, typeOf(form), form, false, meaning};
}

} // namespace mihost::rows

#endif
