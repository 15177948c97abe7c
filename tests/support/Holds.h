#ifndef TESTS_SUPPORT_HOLDS_H
#define TESTS_SUPPORT_HOLDS_H

#include <gtest/gtest.h>
#include <string>

/** Whether a text contains another; a failed expectation shows both. */
inline testing::AssertionResult holds(std::string const& text, std::string const& part)
{
    return (text.find(part) != std::string::npos ? testing::AssertionSuccess()
                                                 : testing::AssertionFailure())
           << "'" << part << "' in '" << text << "'";
}

/** The same for its beginning. */
inline testing::AssertionResult startsWith(std::string const& text, std::string const& start)
{
    return (text.rfind(start, 0) == 0 ? testing::AssertionSuccess() : testing::AssertionFailure())
           << "'" << start << "' at the beginning of '" << text << "'";
}

#endif
