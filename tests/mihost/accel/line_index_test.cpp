#include "mihost/accel/LineIndex.h"
#include "mihost/sandbox/Descriptor.h"
#include "tests/interpose/Libc.h"
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

class AccelLineIndex : public testing::Test
{
protected:
    void write(std::string const& text)
    {
        folder_.write("log", text);
        file_ = mihost::Descriptor(open(folder_.path("log").c_str(), O_RDWR | O_CLOEXEC));
    }

    bool update()
    {
        struct stat now {
        };
        return fstat(file_.get(), &now) == 0 && index_.update(file_.get(), now);
    }

    /** How much it reads for that. */
    std::size_t bytesToUpdate()
    {
        ReadCounter const counter;
        EXPECT_TRUE(update());
        return counter.bytes();
    }

    void expectIndexOf(std::string const& text)
    {
        ASSERT_TRUE(update());
        auto const lines = std::count(text.begin(), text.end(), '\n');
        ASSERT_EQ(index_.lineEnds(), static_cast<std::uint64_t>(lines));
        std::uint64_t const step = 1 + index_.lineEnds() / 500; // of many lines not all are sought
        std::size_t begin = 0;
        for (std::uint64_t line = 1; line <= index_.lineEnds() + 1; ++line) {
            if (line % step == 0 || line > index_.lineEnds()) {
                ASSERT_EQ(index_.find(file_.get(), line), begin) << line;
            }
            begin = text.find('\n', begin) + 1;
        }
        ASSERT_EQ(index_.find(file_.get(), index_.lineEnds() + 2), text.size());
    }

    ScratchFolder folder_;
    mihost::Descriptor file_;
    LineIndex index_;
};

TEST_F(AccelLineIndex, FindsEveryLineWhereverItsBlocksEnd)
{
    std::mt19937 random(1);
    for (std::size_t const longest : {3U, 300U, 70'000U, 200'000U}) {
        std::string text;
        while (text.size() < 3 * LineIndex::block)
            text += std::string(random() % longest, 'x') + '\n';
        text.resize(text.size() - random() % 2, '\n');
        write(text);
        expectIndexOf(text);
    }
    for (std::size_t const size : {LineIndex::block - 1, +LineIndex::block, LineIndex::block + 1}) {
        std::string const text(size, '\n');
        write(text);
        expectIndexOf(text);
    }
}

TEST_F(AccelLineIndex, ReadsOnlyTheEdgesOfAFileThatIsUnchanged)
{
    write(std::string(4'000'000, '\n'));
    EXPECT_EQ(bytesToUpdate(), 4'000'000 + 2 * edge);
    EXPECT_EQ(bytesToUpdate(), 2 * edge);
}

TEST_F(AccelLineIndex, ReadsOnlyEdgesAndTheNewPartOfAGrownFile)
{
    write(std::string(4'000'000, '\n'));
    ASSERT_TRUE(update());
    folder_.append("log", "new\n");
    EXPECT_EQ(bytesToUpdate(), 4 * edge + 4);
    EXPECT_EQ(index_.lineEnds(), 4'000'001U);
}

TEST_F(AccelLineIndex, ReadsOneBlockToFindALine)
{
    write(std::string(4'000'000, '\n'));
    ASSERT_TRUE(update());
    ReadCounter counter;
    for (std::uint64_t line = 1; line < index_.lineEnds(); line += 99991) {
        counter.reset();
        ASSERT_EQ(index_.find(file_.get(), line), line - 1);
        EXPECT_LE(counter.bytes(), +LineIndex::block);
    }
}

TEST_F(AccelLineIndex, NoticesOtherEdgesOfAGrownFile)
{
    std::string const text(100'000, 'a');
    for (std::size_t const changed :
         {std::size_t{0}, edge - 1, text.size() - edge, text.size() - 1}) {
        write(text);
        ASSERT_TRUE(update());
        std::string other = text + "more\n";
        other[changed] = '\n';
        folder_.write("log", other);
        expectIndexOf(other);
    }
}

TEST_F(AccelLineIndex, NoticesWritesAtItsEdgesDespiteOldTimes)
{
    std::string text(100'000, 'a');
    write(text);
    ASSERT_TRUE(update());
    struct stat state {
    };
    ASSERT_EQ(fstat(file_.get(), &state), 0);
    for (std::size_t const changed :
         {std::size_t{0}, edge - 1, text.size() - edge, text.size() - 1}) {
        text[changed] = '\n';
        ASSERT_EQ(pwrite(file_.get(), "\n", 1, static_cast<off_t>(changed)), 1);
        ASSERT_TRUE(index_.update(file_.get(), state)); // with the times of before
        EXPECT_EQ(index_.lineEnds(),
                  static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n')));
    }
}

TEST_F(AccelLineIndex, NoticesAChangeFurtherInsideByItsTime)
{
    std::string text(100'000, 'a');
    write(text);
    struct stat state {
    };
    ASSERT_EQ(fstat(file_.get(), &state), 0);
    ASSERT_TRUE(index_.update(file_.get(), state));
    text[50'000] = '\n';
    ASSERT_EQ(pwrite(file_.get(), "\n", 1, 50'000), 1);
    ++state.st_ctim.tv_nsec;
    ASSERT_TRUE(index_.update(file_.get(), state));
    EXPECT_EQ(index_.lineEnds(), 1U);
}

TEST_F(AccelLineIndex, ReadsAFileAgainThatGotShorter)
{
    write(std::string(100'000, '\n'));
    ASSERT_TRUE(update());
    folder_.write("log", std::string(99'999, '\n'));
    expectIndexOf(std::string(99'999, '\n'));
}

TEST_F(AccelLineIndex, TellsNulBytesWhereverTheyAre)
{
    write("1\n2\n");
    ASSERT_TRUE(update());
    EXPECT_FALSE(index_.hasNul());
    folder_.append("log", std::string(1, '\0'));
    ASSERT_TRUE(update());
    EXPECT_TRUE(index_.hasNul());
    folder_.write("log", "1\n");
    ASSERT_TRUE(update());
    EXPECT_FALSE(index_.hasNul());
}

TEST_F(AccelLineIndex, FailsWhenTheFileEndsBeforeItsSize)
{
    write("1\n2\n");
    {
        libc::HookGuard const guard;
        libc::hooks().pread = [](int, void*, std::size_t, off_t) -> ssize_t { return 0; };
        EXPECT_FALSE(update());
    }
    expectIndexOf("1\n2\n");
}

TEST_F(AccelLineIndex, FindsNothingInAnotherFile)
{
    write("1\n2\n3\n");
    ASSERT_TRUE(update());
    folder_.write("log", "123456");
    EXPECT_FALSE(index_.find(file_.get(), 2));
}

} // namespace line_index_test
