#ifndef HOST_PROPERTYVALUE_H
#define HOST_PROPERTYVALUE_H

#include "host/EnumValue.h"
#include "host/Number.h"

#include <iosfwd>
#include <string>
#include <variant>
#include <vector>

namespace IC
{

/**
 * The typed value of a numbered property.
 *
 * Every constructor takes a flag, which the value keeps for the host. A value type: copies are
 * independent.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class PropertyValue
{
public:
    enum KindType {
        EmptyKind = 0,
        TextKind = 1,
        NumberKind = 2,
        BooleanKind = 3,
        DateKind = 4,
        EnumerationKind = 5,
        NumbersKind = 6,
        TextsKind = 7
    };

    PropertyValue(std::string const& text, bool const& flag);

    /** @param text  must not be null */
    PropertyValue(char const* text, bool const& flag);

    /** A number, a truth value or a date, according to the number's kind. */
    PropertyValue(Number const& number, bool const& flag);

    PropertyValue(EnumValue const& value, bool const& flag);
    PropertyValue(std::vector<Number> const& numbers, bool const& flag);
    PropertyValue(std::vector<std::string> const& texts, bool const& flag);

    /** A value of the given kind that holds nothing yet. */
    PropertyValue(KindType const& kind, bool const& flag);

    PropertyValue(PropertyValue const& other);
    PropertyValue& operator=(PropertyValue const& other);
    ~PropertyValue();

    /**
     * The value as text: texts as they are, numbers in decimal, truth values as "true" or "false",
     * dates as local time "YYYY-MM-DD HH:MM:SS", lists joined by ",", an empty value as "".
     */
    operator std::string() const;

    /**
     * The value as an unsigned number: a number, truth value, enumeration value or date in seconds,
     * or a text of decimal digits only; 0 for everything else and for numbers that do not fit.
     */
    operator unsigned int() const;

    // What a host reads; management interfaces do not call these.

    KindType getKind() const;
    bool getFlag() const;

    /** The number, truth value (0 or 1), seconds or enumeration value; 0 for other kinds. */
    long long getNumber() const;

    /** The list of a value of NumbersKind; empty for other kinds. */
    std::vector<Number> getNumbers() const;

    /** The list of a value of TextsKind; empty for other kinds. */
    std::vector<std::string> getTexts() const;

private:
    using Content = std::variant<std::monostate, std::string, Number, EnumValue,
                                 std::vector<Number>, std::vector<std::string>>;

    KindType kind_;
    bool flag_;
    Content content_;
};

/** Writes the text form, for log messages. */
std::ostream& operator<<(std::ostream& out, PropertyValue const& value);

} // namespace IC

#endif
