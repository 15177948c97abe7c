#include "tests/support/NodeCalls.h"

#include "tests/interpose/Host.h"

NodeCalls::NodeCalls()
{
    host::hooks().setStatus.watch([this](IC::MutableNode*, unsigned int const& status) {
        calls.push_back("setStatus(" + std::to_string(status) + ")");
    });
    host::hooks().setDescription.watch([this](IC::MutableNode*, std::string const& description) {
        calls.push_back("setDescription(" + description + ")");
    });
    host::hooks().setProperty.watch(
        [this](IC::MutableNode*, unsigned int const& id, IC::PropertyValue const&) {
            calls.push_back("setProperty(" + std::to_string(id) + ")");
        });
}

NodeCalls::~NodeCalls()
{
    host::hooks().setStatus.reset();
    host::hooks().setDescription.reset();
    host::hooks().setProperty.reset();
}
