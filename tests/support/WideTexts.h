#ifndef TESTS_SUPPORT_WIDETEXTS_H
#define TESTS_SUPPORT_WIDETEXTS_H

#include <string>
#include <vector>

/** Notes every text that is turned into wide text, or back from it, for as long as it lives. */
class WideTexts
{
public:
    WideTexts();
    ~WideTexts();
    WideTexts(WideTexts const&) = delete;
    WideTexts& operator=(WideTexts const&) = delete;

    std::vector<std::string> widened;
    std::vector<std::string> narrowed;
};

#endif
