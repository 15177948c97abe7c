// Classes that a plug-in creates itself: the host's constructors must keep to their declared size.

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "host/Mutex.h"
#include "host/VXMessageBuffer.h"
#include "mihost/hostcheck/Check.h"
#include "mihost/hostcheck/InRoom.h"

namespace hostcheck
{

namespace
{

template <class Object> std::string within(InRoom<Object> const& object)
{
    return holds(!object.overrun(), "the host writes beyond the " + std::to_string(sizeof(Object)) +
                                        " bytes that host/ declares");
}

/** A copy and an assigned one, too. */
template <class Object> std::string copiesWithin(InRoom<Object>& object)
{
    InRoom<Object> copy(*object);
    InRoom<Object> assigned(*object);
    *assigned = *copy;
    return firstOf({within(object), within(copy), within(assigned)});
}

std::string number()
{
    InRoom<IC::Number> plain(5U);
    InRoom<IC::Number> date(5L, static_cast<unsigned short>(6));
    return firstOf({copiesWithin(plain), copiesWithin(date)});
}

std::string enumValue()
{
    InRoom<IC::EnumValue> value(5U);
    return copiesWithin(value);
}

std::string error()
{
    InRoom<IC::Number> code(0U);
    InRoom<IC::Error> value(static_cast<unsigned char>(1), *code, "text");
    return copiesWithin(value);
}

std::string propertyValue()
{
    InRoom<IC::PropertyValue> text(std::string("text"), true);
    InRoom<IC::Number> five(5U);
    InRoom<IC::PropertyValue> asNumber(*five, true);
    *text = *asNumber;
    return firstOf({copiesWithin(text), copiesWithin(asNumber)});
}

/** A list's elements must have the same distance for host and plug-in. */
std::string numbersInAList()
{
    std::vector<IC::Number> const list = {IC::Number(1U), IC::Number(2U), IC::Number(3U)};
    std::vector<IC::Number> const back = IC::PropertyValue(list, true).getNumbers();
    return firstOf({equal("the length of a list of 3", static_cast<long long>(back.size()), 3),
                    equal("the last of 1, 2, 3", back.empty() ? 0 : back.back().getValue(), 3)});
}

std::string messageBuffer()
{
    InRoom<VXLog::VXMessageBuffer> buffer{};
    *buffer << "text" << 5;
    return within(buffer);
}

std::string mutex()
{
    InRoom<NQ::Mutex> lock{};
    lock->lock(0xFFFFFFFFUL);
    lock->unlock();
    return within(lock);
}

std::string node()
{
    InRoom<IC::MutableNode> object(1U, 2U, std::vector<unsigned int>{3, 4}, 5U, 6U);
    return within(object);
}

std::string interface()
{
    InRoom<IC::ManagementInterface> object{};
    return within(object);
}

} // namespace

Checks layoutChecks()
{
    constexpr char const* size = "has the declared size";
    return {
        {"IC::Number", size, number},
        {"IC::EnumValue", size, enumValue},
        {"IC::Error", size, error},
        {"IC::PropertyValue", size, propertyValue},
        {"IC::Number", "has the declared size in a list", numbersInAList},
        {"VXLog::VXMessageBuffer", size, messageBuffer},
        {"NQ::Mutex", size, mutex},
        {"IC::MutableNode", size, node},
        {"IC::ManagementInterface", size, interface},
    };
}

} // namespace hostcheck
