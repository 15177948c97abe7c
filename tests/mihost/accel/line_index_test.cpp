#include "mihost/accel/LineIndex.h"
#include "mihost/sandbox/Descriptor.h"
#include "tests/support/ReadCounter.h"
#include "tests/support/ScratchFolder.h"

#include <algorithm>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <random>

namespace line_index_test
{

using miaccel::LineIndex;

constexpr std::size_t edge = LineIndex::edge;
constexpr std::size_t textSize = 100'000;
constexpr std::size_t endsOfEdges[] = {0, edge - 1, textSize - edge, textSize - 1};

class AccelLineIndex : public testing::Test
{
protected:
    void write(std::string const& text)
    {
        file_ = mihost::Descriptor(open(folder_.write("log", text).c_str(), O_RDWR | O_CLOEXEC));
    }

    void writeLineEnd(std::size_t place)
    {
        ASSERT_EQ(pwrite(file_.get(), "\n", 1, static_cast<off_t>(place)), 1);
    }

    struct stat state() const
    {
        struct stat now = {};
        EXPECT_EQ(fstat(file_.get(), &now), 0);
        return now;
    }

    /** @return how many bytes the update read */
    std::size_t update()
    {
        ReadCounter const counter;
        EXPECT_TRUE(index_.update(file_.get(), state()));
        return counter.bytes;
    }

    void expectIndexOf(std::string const& text)
    {
        write(text);
        update();
        auto const lines = std::count(text.begin(), text.end(), '\n');
        ASSERT_EQ(index_.lineEnds(), static_cast<std::uint64_t>(lines));
        ASSERT_EQ(index_.hasNul(), text.find('\0') != std::string::npos);
        std::uint64_t const step = 1 + index_.lineEnds() / 500; // not every one of many lines
        std::size_t begin = 0;
        for (std::uint64_t line = 1; line <= index_.lineEnds() + 1; ++line) {
            if (line % step == 0 || line > index_.lineEnds()) {
                ASSERT_EQ(index_.find(file_.get(), line), begin) << line;
            }
            begin = text.find('\n', begin) + 1;
        }
        ASSERT_EQ(index_.find(file_.get(), index_.lineEnds() + 2), text.size());
    }

    ScratchFolder const folder_;
    mihost::Descriptor file_;
    LineIndex index_;
};

TEST_F(AccelLineIndex, FindsEveryLineWhereverBlocksEnd)
{
    std::mt19937 random(1);
    for (std::size_t const longest : {3U, 300U, 70'000U, 200'000U}) {
        std::string text;
        while (text.size() < 3 * LineIndex::block)
            text += std::string(random() % longest, 'x') + '\n';
        text.resize(text.size() - random() % 2, '\n');
        expectIndexOf(text);
    }
    for (std::size_t const size : {LineIndex::block - 1, +LineIndex::block, LineIndex::block + 1})
        expectIndexOf(std::string(size, '\n'));
}

TEST_F(AccelLineIndex, ReadsOnlyTheEdgesAndNewBytes)
{
    write(std::string(4'000'000, '\n'));
    EXPECT_EQ(update(), 4'000'000 + 2 * edge);
    EXPECT_EQ(update(), 2 * edge);
    folder_.append("log", "new\n");
    EXPECT_EQ(update(), 4 * edge + 4);
    EXPECT_EQ(index_.lineEnds(), 4'000'001U);
}

TEST_F(AccelLineIndex, ReadsOneBlockToFindALine)
{
    write(std::string(4'000'000, '\n'));
    update();
    ReadCounter counter;
    for (std::uint64_t line = 1; line < index_.lineEnds(); line += 99991) {
        counter.bytes = 0;
        ASSERT_EQ(index_.find(file_.get(), line), line - 1);
        EXPECT_LE(counter.bytes, +LineIndex::block);
    }
}

TEST_F(AccelLineIndex, NoticesOtherEdgesOfAGrownFile)
{
    std::string const text(textSize, 'a');
    for (std::size_t const changed : endsOfEdges) {
        expectIndexOf(text);
        std::string other = text + "more\n";
        other[changed] = '\n';
        expectIndexOf(other);
    }
}

TEST_F(AccelLineIndex, NoticesWritesByTheEdgesOrTheTime)
{
    write(std::string(textSize, 'a'));
    struct stat taken = state();
    ASSERT_TRUE(index_.update(file_.get(), taken));
    std::uint64_t lineEnds = 0;
    for (std::size_t const changed : endsOfEdges) {
        writeLineEnd(changed);
        ASSERT_TRUE(index_.update(file_.get(), taken)); // with the earlier time
        EXPECT_EQ(index_.lineEnds(), ++lineEnds);
    }
    writeLineEnd(textSize / 2);
    ++taken.st_ctim.tv_nsec;
    ASSERT_TRUE(index_.update(file_.get(), taken));
    EXPECT_EQ(index_.lineEnds(), ++lineEnds);
}

TEST_F(AccelLineIndex, FollowsAFileThatGrowsAndShrinks)
{
    std::string const lines(textSize, '\n');
    std::string const few = "1\n2\n";
    for (std::string const& text : {lines, lines.substr(1), few, few + '\0', few.substr(2)})
        expectIndexOf(text);
}

TEST_F(AccelLineIndex, FailsWhenTheFileEndsBeforeItsSize)
{
    write("1\n2\n");
    libc::hooks().pread = [](int, void*, std::size_t, off_t) -> ssize_t { return 0; };
    EXPECT_FALSE(index_.update(file_.get(), state()));
    libc::hooks().pread.reset();
    expectIndexOf("1\n2\n");
}

TEST_F(AccelLineIndex, FindsNothingInAnotherFile)
{
    write("1\n2\n3\n");
    update();
    write("123456");
    EXPECT_FALSE(index_.find(file_.get(), 2));
}

} // namespace line_index_test
