#include "sysdata/minMaxId.h"

#include "tests/support/FakeFiles.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <array>
#include <cstring>
#include <string>
#include <type_traits>
#include <unistd.h>
#include <vector>

namespace id_ranges_test
{

using NQ::minMaxId;

using Ids = std::vector<unsigned int>;

/** The four values that a file yields: minimum and maximum user id, minimum and maximum group id.
 */
Ids ids(std::string const& text)
{
    FakeFiles const files;
    files.write("/etc/login.defs", text);
    minMaxId range;
    return {range.getMinUserId(), range.getMaxUserId(), range.getMinGroupId(),
            range.getMaxGroupId()};
}

TEST(IdRanges, ReadsTheFourKeys)
{
    struct {
        char const* what;
        std::string text;
        Ids found;
    } const cases[] = {
        {"one blank",
         "UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\n",
         {500, 60000, 500, 60000}},
        {"another order", "GID_MAX 4\nGID_MIN 3\nUID_MAX 2\nUID_MIN 1\n", {1, 2, 3, 4}},
        {"a byte 255 ends the file", "UID_MIN 1000\n\xFFxx\nUID_MAX 60000\n", {1000, 0, 0, 0}},
        {"in a line, too", "UID_MIN 1000\nUMASK \xFF\nUID_MAX 60000\n", {1000, 0, 0, 0}},
        {"a NUL byte ends only its line",
         std::string("UID_MIN 1\0002\nUID_MAX 60000\n", 25),
         {1, 60000, 0, 0}},
        {"one is missing", "UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\n", {500, 60000, 500, 0}},
        {"two are missing", "GID_MIN 500\nGID_MAX 60000\n", {0, 0, 500, 60000}},
        {"all are missing", "", {0, 0, 0, 0}},
        {"the later of two counts", "UID_MIN 500\nUID_MIN 1000\n", {1000, 0, 0, 0}},
        {"until all four are found",
         "UID_MIN 500\nUID_MAX 60000\nGID_MIN 600\nGID_MAX 61000\n"
         "UID_MIN 1\nUID_MAX 2\nGID_MIN 3\nGID_MAX 4\n",
         {500, 60000, 600, 61000}},
        {"of which two equal ones are one",
         "UID_MIN 1\nUID_MIN 2\nUID_MAX 3\nGID_MIN 4\nGID_MAX 5\n",
         {2, 3, 4, 5}},
        {"and one without a number is one",
         "UID_MIN many\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\nUID_MIN 1000\n",
         {0, 60000, 500, 60000}},
        {"the largest id", "UID_MAX 4294967295\n", {0, 4294967295, 0, 0}},
    };
    for (auto const& [what, text, found] : cases)
        EXPECT_EQ(ids(text), found) << what;
    for (std::size_t const length : {4096U, 65536U, 1000000U})
        EXPECT_EQ(ids("#" + std::string(length, 'x') + "\nUID_MIN 1000\n"), (Ids{1000, 0, 0, 0}))
            << length;
}

TEST(IdRanges, ReadsTheNumberAfterAKeyAndOneByte)
{
    struct {
        char const* what;
        char const* text;
        unsigned int minimum;
    } const cases[] = {
        {"more tabs", "UID_MIN\t\t\t1000\n", 1000},
        {"any byte", "UID_MIN=1000\n", 1000},
        {"a hash", "UID_MIN#1000\n", 1000},
        {"that is the first digit", "UID_MIN1000\n", 0},
        {"that is a 1", "UID_MIN1234\n", 234},
        {"a longer key", "UID_MINIMUM 1000\n", 0},
        {"more text", "UID_MIN 1000 and more\n", 1000},
        {"a comment", "#UID_MIN 1000\n", 0},
        {"a key after a blank", " UID_MIN 1000\n", 0},
        {"a key after a tab", "\tUID_MIN 1000\n", 0},
        {"a key after a carriage return", "UMASK 022\rUID_MIN 1000\n", 0},
        {"another key", "SYS_UID_MIN 1000\n", 0},
        {"other lines", "# Range of ids\n\nUMASK 022\nUID_MI 7\nuid_min 8\nUID_MIN 1000\n", 1000},
        {"no line end", "UMASK 022\nUID_MIN 1000", 1000},
        {"nothing after the key", "UID_MIN", 0},
        {"a later text", "UID_MIN 500\nUID_MIN many\n", 500},
        {"a text", "UID_MIN many\n", 0},
        {"a leading zero", "UID_MIN 0100\n", 100},
        {"no hexadecimal", "UID_MIN 0x10\n", 0},
        {"a line end is a blank, too", "UID_MIN \n 1000\n", 1000},
    };
    for (auto const& [what, text, minimum] : cases)
        EXPECT_EQ(ids(text)[0], minimum) << what;
}

TEST(IdRanges, ReadsTheFileInReadMode)
{
    std::vector<std::string> asked;
    libc::hooks().fopen.watch([&asked](std::string const& path, std::string const& mode) {
        asked.push_back(path + "|" + mode);
    });
    minMaxId const range;
    EXPECT_EQ(asked, std::vector<std::string>{"/etc/login.defs|r"});
}

TEST(IdRanges, AreZeroWithoutAFile)
{
    FakeFiles const files;
    Recording const log;
    minMaxId range;
    EXPECT_EQ(range.getMinUserId(), 0U);
    EXPECT_EQ(range.getMaxUserId(), 0U);
    EXPECT_EQ(range.getMinGroupId(), 0U);
    EXPECT_EQ(range.getMaxGroupId(), 0U);
    EXPECT_TRUE(log.records().empty());
}

TEST(IdRanges, TreatsADirectoryAsAnEmptyFile)
{
    FakeFiles const files;
    files.write("/etc/login.defs/file", "");
    minMaxId range;
    EXPECT_EQ(range.getMaxUserId(), 0U);
}

TEST(IdRanges, ClosesTheFileItRead)
{
    FakeFiles const files;
    files.write("/etc/login.defs", "UID_MIN 500\n");
    auto const freeDescriptor = [] {
        int const descriptor = dup(STDERR_FILENO);
        close(descriptor);
        return descriptor;
    };
    int const before = freeDescriptor();
    minMaxId const range;
    EXPECT_EQ(freeDescriptor(), before);
}

TEST(IdRanges, IsReadOncePerProcess)
{
    FakeFiles const files;
    files.write("/etc/login.defs", "UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\n");
    minMaxId* const first = minMaxId::Instance();
    files.write("/etc/login.defs", "UID_MIN 1\nUID_MAX 2\nGID_MIN 3\nGID_MAX 4\n");
    minMaxId* const second = minMaxId::Instance();
    EXPECT_EQ(first, second);
    EXPECT_EQ(second->getMinUserId(), 500U);
    EXPECT_EQ(second->getMaxUserId(), 60000U);
    EXPECT_EQ(second->getMinGroupId(), 500U);
    EXPECT_EQ(second->getMaxGroupId(), 60000U);
}

TEST(IdRanges, HasOnlyTheLowestIdsAndThenTheHighestAsFields)
{
    FakeFiles const files;
    files.write("/etc/login.defs", "UID_MIN 1\nGID_MIN 2\nUID_MAX 3\nGID_MAX 4\n");
    minMaxId const range;
    std::array<unsigned int, 4> fields{};
    static_assert(sizeof fields == sizeof range && std::is_trivially_copyable_v<minMaxId>);
    std::memcpy(fields.data(), &range, sizeof fields);
    EXPECT_EQ(fields, (std::array<unsigned int, 4>{1, 2, 3, 4}));
}

} // namespace id_ranges_test
