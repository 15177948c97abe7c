// The small value types: Number, EnumValue, Error, Alert.

#include "host/Alert.h"
#include "host/EnumValue.h"
#include "host/Error.h"
#include "mihost/hostcheck/Check.h"

#include <climits>

namespace hostcheck
{

namespace
{

using IC::EnumValue;
using IC::Error;
using IC::Number;

std::string reads(Number const& number, Number::KindType kind, long long value, int subSeconds)
{
    return firstOf({equal("getKind", number.getKind(), kind),
                    equal("getValue", number.getValue(), value),
                    equal("getSubSeconds", number.getSubSeconds(), subSeconds)});
}

std::string unsignedNumber()
{
    return firstOf({reads(Number(0U), Number::UnsignedKind, 0, 0),
                    reads(Number(UINT_MAX), Number::UnsignedKind, UINT_MAX, 0)});
}

std::string booleanNumber()
{
    return firstOf({reads(Number(true), Number::BooleanKind, 1, 0),
                    reads(Number(false), Number::BooleanKind, 0, 0)});
}

std::string dateNumber()
{
    return firstOf({reads(Number(-1L, static_cast<unsigned short>(0)), Number::DateKind, -1, 0),
                    reads(Number(LONG_MAX, static_cast<unsigned short>(USHRT_MAX)),
                          Number::DateKind, LONG_MAX, USHRT_MAX)});
}

std::string emptyNumber()
{
    return firstOf({reads(Number(Number::EmptyKind), Number::EmptyKind, 0, 0),
                    reads(Number(Number::DateKind), Number::DateKind, 0, 0)});
}

std::string copiedNumber()
{
    Number const date(7L, static_cast<unsigned short>(8));
    return reads(Number(date), Number::DateKind, 7, 8);
}

std::string assignedNumber()
{
    Number const date(7L, static_cast<unsigned short>(8));
    Number assigned(5U);
    Number& result = assigned = date;
    return firstOf({reads(assigned, Number::DateKind, 7, 8),
                    holds(&result == &assigned, "the result is another object")});
}

std::string enumFromUnsigned()
{
    return firstOf({equal("getValue", EnumValue(0U).getValue(), 0),
                    equal("getValue", EnumValue(UINT_MAX).getValue(), UINT_MAX)});
}

std::string enumFromShort()
{
    constexpr unsigned short highest = USHRT_MAX;
    return equal("getValue", EnumValue(highest).getValue(), highest);
}

std::string copiedEnum()
{
    EnumValue const value(7U);
    return equal("getValue of the copy", EnumValue(value).getValue(), 7);
}

std::string assignedEnum()
{
    EnumValue assigned(5U);
    assigned = EnumValue(7U);
    return equal("getValue", assigned.getValue(), 7);
}

Error error(int status, std::string const& text)
{
    return {static_cast<unsigned char>(status), Number(Number::EmptyKind), text};
}

std::string statusOfError()
{
    return firstOf({equal("getStatus", error(0, "").getStatus(), 0),
                    equal("getStatus", error(1, "").getStatus(), 1),
                    equal("getStatus", error(UCHAR_MAX, "").getStatus(), UCHAR_MAX)});
}

std::string enumerationOfError()
{
    return firstOf({equal("status 0", static_cast<Error::StatusType>(error(0, "")), Error::Success),
                    equal("status 1", static_cast<Error::StatusType>(error(1, "")), Error::Failure),
                    holds(static_cast<Error::StatusType>(error(7, "")) != Error::Success,
                          "status 7 is Success")});
}

std::string formOfError()
{
    std::string const form = error(1, "the reason");
    return firstOf(
        {holds(form.find("the reason") != std::string::npos,
               "the form of a failure lacks its text"),
         holds(!static_cast<std::string>(error(0, "")).empty(), "the form of a success is empty")});
}

std::string textOfError()
{
    for (std::string const& text : oddTexts())
        if (std::string problem = equal("getText", error(1, text).getText(), text);
            !problem.empty())
            return problem;
    return "";
}

std::string copiedError()
{
    Error const original = error(7, "reason");
    Error const copy(original); // NOLINT(performance-unnecessary-copy-initialization)
    return firstOf({equal("getStatus of the copy", copy.getStatus(), 7),
                    equal("getText of the copy", copy.getText(), "reason")});
}

std::string assignedError()
{
    Error assigned = error(0, "");
    assigned = error(7, "reason");
    return firstOf({equal("getStatus", assigned.getStatus(), 7),
                    equal("getText", assigned.getText(), "reason")});
}

std::string alert()
{
    IC::Alert const original(7, "text");
    IC::Alert assigned(8, "other");
    assigned = IC::Alert(original);
    return firstOf({equal("getNodeId", original.getNodeId(), 7),
                    equal("getText", original.getText(), "text"),
                    equal("getNodeId of a copy", assigned.getNodeId(), 7),
                    equal("getText of a copy", assigned.getText(), "text")});
}

} // namespace

Checks valueChecks()
{
    return {
        {"IC::Number::Number(unsigned int const&)", "makes an unsigned number", unsignedNumber},
        {"IC::Number::Number(bool const&)", "makes a truth value", booleanNumber},
        {"IC::Number::Number(long, unsigned short)", "makes a point in time", dateNumber},
        {"IC::Number::Number(KindType const&)", "makes an empty number of that kind", emptyNumber},
        {"IC::Number::Number(Number const&)", "copies", copiedNumber},
        {"IC::Number::operator=", "copies", assignedNumber},
        {"IC::EnumValue::EnumValue(unsigned int const&)", "keeps the value", enumFromUnsigned},
        {"IC::EnumValue::EnumValue(unsigned short const&)", "keeps the value", enumFromShort},
        {"IC::EnumValue::EnumValue(EnumValue const&)", "copies", copiedEnum},
        {"IC::EnumValue::operator=", "copies", assignedEnum},
        {"IC::Error::getStatus", "returns the status", statusOfError},
        {"IC::Error::operator StatusType", "is Success for status 0 only", enumerationOfError},
        {"IC::Error::operator std::string", "contains the text", formOfError},
        {"IC::Error::getText", "returns the text, every byte of it", textOfError},
        {"IC::Error::Error(Error const&)", "copies", copiedError},
        {"IC::Error::operator=", "copies", assignedError},
        {"IC::Alert", "keeps a node id and a text", alert},
    };
}

} // namespace hostcheck
