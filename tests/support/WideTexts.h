#ifndef TESTS_SUPPORT_WIDETEXTS_H
#define TESTS_SUPPORT_WIDETEXTS_H

#include <string>
#include <vector>

/** Notes every text that the host's conversions turn into another kind, while it lives. */
class WideTexts
{
public:
    WideTexts();
    ~WideTexts();
    WideTexts(WideTexts const&) = delete;
    WideTexts& operator=(WideTexts const&) = delete;

    std::vector<std::string> widened;
    std::vector<std::string> narrowed;

    /** C strings that were made into texts. */
    std::vector<std::string> made;
};

#endif
