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

/** The four values that a file yields: minimum and maximum user id, minimum and maximum group id.
 */
std::vector<unsigned int> ids(std::string const& text)
{
    FakeFiles const files;
    files.write("/etc/login.defs", text);
    minMaxId range;
    return {range.getMinUserId(), range.getMaxUserId(), range.getMinGroupId(),
            range.getMaxGroupId()};
}

unsigned int minUserId(std::string const& text)
{
    return ids(text)[0];
}

using Ids = std::vector<unsigned int>;

TEST(IdRanges, ReadsTheFourKeysAfterOneBlank)
{
    EXPECT_EQ(ids("UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\n"),
              (Ids{500, 60000, 500, 60000}));
}

TEST(IdRanges, KeepsTheFourKeysApart)
{
    EXPECT_EQ(ids("GID_MAX 4\nGID_MIN 3\nUID_MAX 2\nUID_MIN 1\n"), (Ids{1, 2, 3, 4}));
}

TEST(IdRanges, ReadsTheFileInReadMode)
{
    libc::HookGuard const guard;
    std::vector<std::string> asked;
    libc::hooks().fopen = [&asked](char const* path, char const* mode) -> FILE* {
        asked.push_back(std::string(path) + "|" + mode);
        return nullptr;
    };
    minMaxId const range;
    EXPECT_EQ(asked, std::vector<std::string>{"/etc/login.defs|r"});
}

TEST(IdRanges, SkipsFurtherTabsBeforeTheValue)
{
    EXPECT_EQ(minUserId("UID_MIN\t\t\t1000\n"), 1000U);
}

TEST(IdRanges, IgnoresTheByteAfterTheKey)
{
    EXPECT_EQ(minUserId("UID_MIN=1000\n"), 1000U);
    EXPECT_EQ(minUserId("UID_MIN#1000\n"), 1000U);
}

TEST(IdRanges, LosesTheFirstDigitOfAValueRightAfterTheKey)
{
    EXPECT_EQ(minUserId("UID_MIN1000\n"), 0U);
    EXPECT_EQ(minUserId("UID_MIN1234\n"), 234U);
}

TEST(IdRanges, MatchesAKeyWhateverFollowsIt)
{
    EXPECT_EQ(minUserId("UID_MINIMUM 1000\n"), 0U);
    EXPECT_EQ(minUserId("UID_MIN 1000 and more\n"), 1000U);
}

TEST(IdRanges, IgnoresAKeyAfterAHashOrABlank)
{
    EXPECT_EQ(minUserId("#UID_MIN 1000\n"), 0U);
    EXPECT_EQ(minUserId(" UID_MIN 1000\n"), 0U);
    EXPECT_EQ(minUserId("\tUID_MIN 1000\n"), 0U);
    EXPECT_EQ(minUserId("SYS_UID_MIN 1000\n"), 0U);
}

TEST(IdRanges, IgnoresOtherLines)
{
    EXPECT_EQ(minUserId("# Range of ids\n\nUMASK 022\nUID_MI 7\nuid_min 8\nUID_MIN 1000\n"), 1000U);
}

TEST(IdRanges, ReadsALastLineWithoutALineEnd)
{
    EXPECT_EQ(minUserId("UMASK 022\nUID_MIN 1000"), 1000U);
    EXPECT_EQ(minUserId("UID_MIN"), 0U);
}

TEST(IdRanges, EndsAtAByte255)
{
    EXPECT_EQ(ids("UID_MIN 1000\n\xFFxx\nUID_MAX 60000\n"), (Ids{1000, 0, 0, 0}));
    EXPECT_EQ(ids("UID_MIN 1000\nUMASK \xFF\nUID_MAX 60000\n"), (Ids{1000, 0, 0, 0}));
}

TEST(IdRanges, ContinuesAfterANulByte)
{
    EXPECT_EQ(ids(std::string("UID_MIN 1\0"
                              "2\nUID_MAX 60000\n",
                              25)),
              (Ids{1, 60000, 0, 0}));
}

TEST(IdRanges, LeavesAKeyThatIsMissingAtZero)
{
    EXPECT_EQ(ids("UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\n"), (Ids{500, 60000, 500, 0}));
    EXPECT_EQ(ids("GID_MIN 500\nGID_MAX 60000\n"), (Ids{0, 0, 500, 60000}));
    EXPECT_EQ(ids(""), (Ids{0, 0, 0, 0}));
}

TEST(IdRanges, TakesTheLaterOfTwoValuesWhileAnyKeyIsMissing)
{
    EXPECT_EQ(ids("UID_MIN 500\nUID_MIN 1000\n"), (Ids{1000, 0, 0, 0}));
}

TEST(IdRanges, StopsOnceAllFourKeysAreFound)
{
    EXPECT_EQ(ids("UID_MIN 500\nUID_MAX 60000\nGID_MIN 600\nGID_MAX 61000\n"
                  "UID_MIN 1\nUID_MAX 2\nGID_MIN 3\nGID_MAX 4\n"),
              (Ids{500, 60000, 600, 61000}));
}

TEST(IdRanges, CountsARepeatedKeyOnlyOnceTowardsTheFour)
{
    EXPECT_EQ(ids("UID_MIN 1\nUID_MIN 2\nUID_MAX 3\nGID_MIN 4\nGID_MAX 5\n"), (Ids{2, 3, 4, 5}));
}

TEST(IdRanges, KeepsTheEarlierValueIfALaterOneIsNotANumber)
{
    EXPECT_EQ(minUserId("UID_MIN 500\nUID_MIN many\n"), 500U);
    EXPECT_EQ(minUserId("UID_MIN many\n"), 0U);
}

TEST(IdRanges, CountsAKeyWithoutANumberAsFound)
{
    EXPECT_EQ(ids("UID_MIN many\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\nUID_MIN 1000\n"),
              (Ids{0, 60000, 500, 60000}));
}

TEST(IdRanges, ReadsTheLargestId)
{
    EXPECT_EQ(ids("UID_MAX 4294967295\n"), (Ids{0, 4294967295, 0, 0}));
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

TEST(IdRanges, ReadsAFileOfAnyLengthToItsEnd)
{
    for (std::size_t const length : {4096U, 65536U, 1000000U})
        EXPECT_EQ(ids("#" + std::string(length, 'x') + "\nUID_MIN 1000\n"), (Ids{1000, 0, 0, 0}))
            << length;
}

TEST(IdRanges, ReadsAnUnsignedDecimalAfterAnyBlanks)
{
    EXPECT_EQ(minUserId("UID_MIN 0100\n"), 100U);
    EXPECT_EQ(minUserId("UID_MIN 0x10\n"), 0U);
    EXPECT_EQ(minUserId("UID_MIN \n 1000\n"), 1000U); // a line end is skipped, too
}

} // namespace id_ranges_test
