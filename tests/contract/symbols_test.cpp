// The symbols that the libraries need and export, compared with the lists in this directory.
//
// To update the lists on purpose: script/symbols --update

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <iterator>

namespace symbols_test
{

using Names = std::vector<std::string>;

struct List {
    char const* name;
    char const* kind;
    char const* file;
};

class Symbols : public testing::TestWithParam<List>
{
protected:
    static Names inTheLibrary()
    {
        Outcome const outcome =
            runToEnd({TESTS_DIR "/../script/symbols", GetParam().kind, GetParam().file});
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        return linesOf(outcome.out);
    }

    static Names listed()
    {
        return linesOf(
            contentOf(std::string(TESTS_DIR "/contract/") + GetParam().name + "_symbols.txt"));
    }

    /** The names of one list that the other lacks; both are sorted. */
    static Names missing(Names const& from, Names const& in)
    {
        Names found;
        std::set_difference(from.begin(), from.end(), in.begin(), in.end(),
                            std::back_inserter(found));
        return found;
    }
};

TEST_P(Symbols, OfTheLibraryAreThoseListed)
{
    Names const found = inTheLibrary();
    Names const expected = listed();
    ASSERT_FALSE(expected.empty());
    EXPECT_EQ(missing(found, expected), Names()) << "not listed";
    EXPECT_EQ(missing(expected, found), Names()) << "not in the library";
}

INSTANTIATE_TEST_SUITE_P(Lists, Symbols,
                         testing::Values(List{"undefined", "undefined", PLUGIN_FILE},
                                         List{"exported", "exported", PLUGIN_FILE},
                                         List{"runtime", "exported", RUNTIME_FILE}),
                         [](auto const& list) { return std::string(list.param.name); });

TEST(Runtime, ExportsNothingOfTheStandardLibrary)
{
    Outcome const outcome = runToEnd({"/usr/bin/nm", "--dynamic", "--defined-only", RUNTIME_FILE});
    ASSERT_NE(outcome.out.find(" _ZN2IC4Node"), std::string::npos) << outcome.err;
    for (std::string const& line : linesOf(outcome.out))
        for (char const* beginning : {" _ZNSt", " _ZNKSt", " _ZSt"})
            EXPECT_EQ(line.find(beginning), std::string::npos) << line;
}

/** All symbols that the library needs, also of the C and C++ runtimes; mangled. */
std::string wanted()
{
    Outcome const outcome = runToEnd({"/usr/bin/nm", "--dynamic", "--undefined-only", PLUGIN_FILE});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    return outcome.out;
}

TEST(Library, StartsNoThreadSendsNoSignalAndThrowsNothingOfItsOwn)
{
    std::string const names = wanted();
    ASSERT_NE(names.find(" popen"), std::string::npos);
    for (char const* name : {"pthread_create", "thrd_create", "_M_start_thread", " clone", " fork",
                             " kill", " tgkill", " raise", " sigqueue", "__cxa_throw"})
        EXPECT_EQ(names.find(name), std::string::npos) << name;
}

} // namespace symbols_test
