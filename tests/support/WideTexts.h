#ifndef TESTS_SUPPORT_WIDETEXTS_H
#define TESTS_SUPPORT_WIDETEXTS_H

#include <string>
#include <vector>

/** Records every text that the host's conversions convert while it exists. */
class WideTexts
{
public:
    WideTexts();
    ~WideTexts();
    WideTexts(WideTexts const&) = delete;
    WideTexts& operator=(WideTexts const&) = delete;

    std::vector<std::string> widened;
    std::vector<std::string> narrowed;

    /** C strings that were converted into texts. */
    std::vector<std::string> made;
};

#endif
