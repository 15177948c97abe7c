#include "tests/support/NodeCalls.h"

#include "host/MutableNode.h"
#include "tests/support/Next.h"

namespace
{

NodeCalls* inUse = nullptr;

void note(std::string call)
{
    if (inUse)
        inUse->calls.push_back(std::move(call));
}

/** The framework's own, past the ones below. */
template <class Argument> using Setter = IC::Error(IC::MutableNode* node, Argument const& argument);

} // namespace

NodeCalls::NodeCalls()
{
    inUse = this;
}

NodeCalls::~NodeCalls()
{
    inUse = nullptr;
}

namespace IC
{

Error MutableNode::setStatus(unsigned int const& status)
{
    static auto* const real = next<Setter<unsigned int>>("_ZN2IC11MutableNode9setStatusERKj");
    note("setStatus(" + std::to_string(status) + ")");
    return real(this, status);
}

Error MutableNode::setDescription(std::string const& description)
{
    static auto* const real = next<Setter<std::string>>(
        "_ZN2IC11MutableNode14setDescriptionERKNSt7__cxx1112basic_stringIcSt11char_traitsIcE"
        "SaIcEEE");
    note("setDescription(" + description + ")");
    return real(this, description);
}

Error MutableNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    using SetProperty = Error(MutableNode*, unsigned int const&, PropertyValue const&);
    static auto* const real =
        next<SetProperty>("_ZN2IC11MutableNode11setPropertyERKjRKNS_13PropertyValueE");
    note("setProperty(" + std::to_string(id) + ")");
    return real(this, id, value);
}

} // namespace IC
