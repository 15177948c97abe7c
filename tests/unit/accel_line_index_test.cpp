#include "mihost/accel/LineIndex.h"
#include "tests/support/ScratchFolder.h"
#include "tests/unit/AccelStandIns.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <random>

namespace
{

using miaccel::Extent;
using miaccel::LineIndex;
using miaccel::TextFile;

/** Small enough for every path to be taken by short texts. */
LineIndex::Limits smallLimits()
{
    LineIndex::Limits limits;
    limits.block = 8;
    limits.maxBlocks = 4;
    limits.cheap = 16;
    return limits;
}

std::uint64_t countIn(std::string const& text)
{
    return static_cast<std::uint64_t>(std::count(text.begin(), text.end(), '\n'));
}

/** The line as it stands in the text, found by walking through it. */
std::string lineIn(std::string const& text, std::uint64_t line)
{
    std::string::size_type begin = 0;
    while (--line > 0) {
        begin = text.find('\n', begin);
        if (begin == std::string::npos)
            return {};
        ++begin;
    }
    std::string::size_type const end = text.find('\n', begin);
    return text.substr(begin, end == std::string::npos ? end : end + 1 - begin);
}

void expectIndexOf(std::string const& text, LineIndex& index, TextFile const& file)
{
    ASSERT_TRUE(index.update(file));
    ASSERT_EQ(index.lineEnds(), countIn(text));
    for (std::uint64_t line = 1; line <= countIn(text) + 2; ++line) {
        std::optional<Extent> const extent = index.find(file, line);
        ASSERT_TRUE(extent);
        ASSERT_LE(extent->offset + extent->length, text.size());
        ASSERT_EQ(text.substr(extent->offset, extent->length), lineIn(text, line)) << line;
    }
}

std::string randomText(std::mt19937& random, std::size_t most)
{
    std::string text(random() % (most + 1), '\0');
    unsigned int const density = 1 + random() % 8;
    for (char& character : text)
        character = random() % density == 0 ? '\n' : static_cast<char>(random() % 256);
    return text;
}

TEST(LineIndex, FindsEveryLineOfThousandsOfTexts)
{
    ScratchFolder const folder;
    std::mt19937 random(1);
    for (int i = 0; i < 1500; ++i) {
        std::string const text = randomText(random, 200);
        TextFile const file(folder.write("text", text));
        LineIndex index(smallLimits());
        expectIndexOf(text, index, file);
        if (HasFatalFailure())
            return;
    }
}

TEST(LineIndex, FollowsAFileThatGrows)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    std::mt19937 random(2);
    LineIndex index(smallLimits());
    std::string text;
    for (int i = 0; i < 120; ++i) {
        std::string const more = randomText(random, 20);
        text += more;
        folder.append("text", more);
        expectIndexOf(text, index, TextFile(folder.path("text")));
        if (HasFatalFailure())
            return;
    }
}

TEST(LineIndex, FollowsAFileThatIsWrittenAnewAgainAndAgain)
{
    ScratchFolder const folder;
    std::mt19937 random(3);
    LineIndex index(smallLimits());
    for (int i = 0; i < 1000; ++i) {
        std::string const text = randomText(random, 60);
        expectIndexOf(text, index, TextFile(folder.write("text", text)));
        if (HasFatalFailure())
            return;
    }
}

TEST(LineIndex, ReadsNothingOfAFileThatIsUnchanged)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    TextFile const file(folder.write("text", std::string(100000, '\n')));
    LineIndex index;
    ASSERT_TRUE(index.update(file));
    accelStandIns::ReadCounter const counter;
    ASSERT_TRUE(index.update(file));
    EXPECT_EQ(counter.bytes(), 0U);
}

TEST(LineIndex, ReadsAFileAgainThatChangedInTheVeryTickOfTheLastLook)
{
    ScratchFolder const folder;
    TextFile const file(folder.write("text", "1\n2\n"));
    accelStandIns::hooks().clock_gettime = [](clockid_t, timespec* now) {
        *now = {}; // long before the file's change
        return 0;
    };
    accelStandIns::Guard const guard;
    LineIndex index;
    ASSERT_TRUE(index.update(file));
    accelStandIns::ReadCounter const counter;
    ASSERT_TRUE(index.update(file));
    EXPECT_GE(counter.bytes(), 4U);
}

TEST(LineIndex, ReadsOnlyTheEndsAndWhatIsNewOfALongFileThatHasGrown)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    std::size_t const size = 4 * 1024 * 1024;
    TextFile const file(folder.write("text", std::string(size, '\n')));
    LineIndex index;
    ASSERT_TRUE(index.update(file));
    folder.append("text", "new\n");
    accelStandIns::ReadCounter const counter;
    ASSERT_TRUE(index.update(file));
    EXPECT_EQ(index.lineEnds(), size + 1);
    EXPECT_EQ(counter.bytes(), 4 * 4096U + 4);
}

TEST(LineIndex, ReadsTwoBlocksAtMostToFindALine)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    TextFile const file(folder.write("text", std::string(4 * 1024 * 1024, '\n')));
    LineIndex index;
    ASSERT_TRUE(index.update(file));
    accelStandIns::ReadCounter counter;
    for (std::uint64_t line = 1; line < index.lineEnds(); line += 99991) {
        counter.reset();
        ASSERT_TRUE(index.find(file, line));
        EXPECT_LE(counter.bytes(), 2 * LineIndex::Limits().block);
    }
}

TEST(LineIndex, ReadsALongFileAgainWhoseBeginningIsAnotherOne)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    LineIndex index(smallLimits());
    ASSERT_TRUE(index.update(TextFile(folder.write("text", std::string(5000, 'a')))));
    std::string const other = "\n" + std::string(5000, 'a');
    expectIndexOf(other, index, TextFile(folder.write("text", other)));
}

TEST(LineIndex, ReadsALongFileAgainWhoseEndIsAnotherOne)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    LineIndex index(smallLimits());
    ASSERT_TRUE(index.update(TextFile(folder.write("text", std::string(9000, 'a')))));
    std::string const other = std::string(8999, 'a') + "\n\n";
    expectIndexOf(other, index, TextFile(folder.write("text", other)));
}

TEST(LineIndex, ReadsAFileAgainThatGotShorter)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    LineIndex index(smallLimits());
    ASSERT_TRUE(index.update(TextFile(folder.write("text", std::string(9000, '\n')))));
    std::string const shorter(8999, '\n');
    ASSERT_TRUE(index.update(TextFile(folder.write("text", shorter))));
    EXPECT_EQ(index.lineEnds(), 8999U);
}

TEST(LineIndex, ReadsAFileAgainThatWasOverwrittenAtTheSameSize)
{
    accelStandIns::LongAfterwards const settled;
    ScratchFolder const folder;
    LineIndex index(smallLimits());
    ASSERT_TRUE(index.update(TextFile(folder.write("text", "abc\ndef\n"))));
    expectIndexOf("a\nc\nd\nf\n", index, TextFile(folder.write("text", "a\nc\nd\nf\n")));
}

TEST(LineIndex, FailsWhereTheFileEndsBeforeItsSize)
{
    ScratchFolder const folder;
    TextFile const file(folder.write("text", "1\n2\n"));
    accelStandIns::Guard const guard;
    accelStandIns::hooks().pread = [](int, void*, std::size_t, off_t) -> ssize_t { return 0; };
    LineIndex index;
    EXPECT_FALSE(index.update(file));
    accelStandIns::hooks().pread = nullptr;
    EXPECT_TRUE(index.update(file));
    EXPECT_EQ(index.lineEnds(), 2U);
}

TEST(LineIndex, FindsNothingWhereTheFileIsNoLongerTheIndexedOne)
{
    ScratchFolder const folder;
    TextFile const file(folder.write("text", "1\n2\n3\n"));
    LineIndex index;
    ASSERT_TRUE(index.update(file));
    folder.write("text", "123456");
    EXPECT_FALSE(index.find(file, 2));
}

TEST(TextFile, GoesOnAfterShortAndInterruptedReads)
{
    ScratchFolder const folder;
    TextFile const file(folder.write("text", "0123456789"));
    accelStandIns::Guard const guard;
    int calls = 0;
    accelStandIns::hooks().pread = [&calls](int descriptor, void* buffer, std::size_t size,
                                            off_t offset) -> ssize_t {
        if (++calls % 2 == 0) {
            errno = EINTR;
            return -1;
        }
        return accelStandIns::realPread(descriptor, buffer, std::min<std::size_t>(size, 3), offset);
    };
    std::string text(8, '\0');
    ASSERT_TRUE(file.read(text.data(), text.size(), 1));
    EXPECT_EQ(text, "12345678");
}

} // namespace
