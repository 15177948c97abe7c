#ifndef TESTS_SUPPORT_MIHOST_H
#define TESTS_SUPPORT_MIHOST_H

#include "tests/support/Program.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

using Json = nlohmann::ordered_json;

/** Runs mihost with --json. @return what it prints */
inline Json mihostJson(std::vector<std::string> arguments)
{
    arguments.insert(arguments.begin(), "--json");
    return Json::parse(mihostRun(arguments).out);
}

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
