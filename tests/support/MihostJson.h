#ifndef TESTS_SUPPORT_MIHOSTJSON_H
#define TESTS_SUPPORT_MIHOSTJSON_H

#include "tests/support/Program.h"

#include <nlohmann/json.hpp>

using Json = nlohmann::ordered_json;

/** Runs mihost with --json. @return what it prints */
inline Json mihostJson(std::vector<std::string> arguments)
{
    arguments.insert(arguments.begin(), "--json");
    return Json::parse(mihostRun(arguments).out);
}

#endif
