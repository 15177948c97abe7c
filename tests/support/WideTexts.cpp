#include "tests/support/WideTexts.h"

#include "tests/interpose/Host.h"

WideTexts::WideTexts()
{
    host::hooks().widen.watch([this](std::string const& text) { widened.push_back(text); });
    host::hooks().narrow.watch([this](std::wstring const& text) {
        narrowed.push_back(host::hooks().narrow.real()(text));
    });
    host::hooks().makeText.watch([this](char const* text) { made.emplace_back(text); });
}

WideTexts::~WideTexts()
{
    host::hooks().widen.reset();
    host::hooks().narrow.reset();
    host::hooks().makeText.reset();
}
