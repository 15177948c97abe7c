#include "tests/interpose/Host.h"

#include "host/make_string.h"
#include "tests/interpose/Real.h"

namespace host
{

namespace
{

IC::Error failure()
{
    return {1, IC::Number(IC::Number::EmptyKind), ""};
}

} // namespace

Hooks::Hooks()
    : setStatus("setStatus", failure()), setDescription("setDescription", failure()),
      setProperty("setProperty", failure())
{
}

Hooks& hooks()
{
    static Hooks inUse;
    return inUse;
}

} // namespace host

using host::hooks;
using interpose::real;

namespace IC
{

Error MutableNode::setStatus(unsigned int const& status)
{
    static auto* const next = real<Error(MutableNode*, unsigned int const&)>();
    return hooks().setStatus(next, this, status);
}

Error MutableNode::setDescription(std::string const& description)
{
    static auto* const next = real<Error(MutableNode*, std::string const&)>();
    return hooks().setDescription(next, this, description);
}

Error MutableNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    static auto* const next =
        real<Error(MutableNode*, unsigned int const&, PropertyValue const&)>();
    return hooks().setProperty(next, this, id, value);
}

} // namespace IC

namespace NQ
{

int Mutex::lock(unsigned long timeout)
{
    static auto* const next = real(&Mutex::lock);
    return hooks().lock(next, this, timeout);
}

int Mutex::unlock()
{
    static auto* const next = real(&Mutex::unlock);
    return hooks().unlock(next, this);
}

std::wstring make_wstring(std::string const& text)
{
    static auto* const next = real<std::wstring(std::string const&)>();
    return hooks().widen(next, text);
}

std::string make_string(std::wstring const& text)
{
    static auto* const next = real<std::string(std::wstring const&)>();
    return hooks().narrow(next, text);
}

std::string make_string(char const* text)
{
    static auto* const next = real<std::string(char const*)>();
    return hooks().makeText(next, text);
}

} // namespace NQ

namespace VXLog
{

std::string VXMessageBuffer::str(VXMessageBuffer& end)
{
    static auto* const next = real<std::string(VXMessageBuffer*, VXMessageBuffer&)>();
    return hooks().textOfBuffer(next, this, end);
}

std::string VXMessageBuffer::str(std::ostream& end)
{
    static auto* const next = real<std::string(VXMessageBuffer*, std::ostream&)>();
    return hooks().textOfStream(next, this, end);
}

} // namespace VXLog
