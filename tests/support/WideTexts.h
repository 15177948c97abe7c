#ifndef TESTS_SUPPORT_WIDETEXTS_H
#define TESTS_SUPPORT_WIDETEXTS_H

#include "tests/interpose/Host.h"

#include <string>
#include <vector>

/** Records every text that the host's conversions convert while it exists. */
class WideTexts
{
public:
    WideTexts()
    {
        host::hooks().widen.watch([this](std::string const& text) { widened.push_back(text); });
        host::hooks().narrow.watch([this](std::wstring const& text) {
            narrowed.push_back(host::hooks().narrow.real()(text));
        });
        host::hooks().makeText.watch([this](char const* text) { made.emplace_back(text); });
    }
    ~WideTexts()
    {
        host::hooks().widen.reset();
        host::hooks().narrow.reset();
        host::hooks().makeText.reset();
    }
    WideTexts(WideTexts const&) = delete;
    WideTexts& operator=(WideTexts const&) = delete;

    std::vector<std::string> widened;
    std::vector<std::string> narrowed;

    /** C strings that were converted into texts. */
    std::vector<std::string> made;
};

#endif
