#ifndef TESTS_SYSDATA_METHODTEST_H
#define TESTS_SYSDATA_METHODTEST_H

#include "sysdata/osInfo_linux.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

/** A machine with an empty /etc; commands are only recorded, and print nothing. */
class MethodTest : public testing::Test
{
protected:
    using Params = std::vector<NQ::ParamInfo>;

    MethodTest()
    {
        commands_.otherwise = "";
    }

    /** Carries out a method-call text; true for success. */
    static bool call(std::string const& text)
    {
        return NQ::OsInfo().setCreateUser(text);
    }

    static int execute(std::string const& method, Params const& params)
    {
        bool shadowing = false;
        return NQ::OsInfo().executeMethod(method, params, shadowing);
    }

    static NQ::ParamInfo text(std::string const& name, std::string const& value)
    {
        return {name, "CMPI_string", value};
    }

    FakeFiles files_;
    FakeCommands commands_;
};

#endif
