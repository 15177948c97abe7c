#include "mihost/accel/Stream.h"
#include "tests/support/BothWays.h"

#include <cerrno>
#include <gtest/gtest.h>
#include <thread>
#include <vector>

namespace
{

using miaccel::closeStream;
using miaccel::openStream;

TEST(AccelStream, GivesItsTextWholeWithNulBytes)
{
    std::string text(3 * 1024 * 1024, '\0');
    text[70000] = '\n';
    FILE* const stream = openStream(text);
    EXPECT_TRUE(bothways::readAll(stream) == text);
    EXPECT_TRUE(std::feof(stream));
    EXPECT_FALSE(std::ferror(stream));
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, GivesLinesAsFgetsReadsThem)
{
    FILE* const stream = openStream("first\nsecond line\nthird");
    char buffer[8];
    std::vector<std::string> pieces;
    while (std::fgets(buffer, sizeof buffer, stream))
        pieces.emplace_back(buffer);
    EXPECT_EQ(pieces, (std::vector<std::string>{"first\n", "second ", "line\n", "third"}));
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, IsAtItsEndAtOnceWhenEmpty)
{
    FILE* const stream = openStream("");
    EXPECT_EQ(std::fgetc(stream), EOF);
    EXPECT_TRUE(std::feof(stream));
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, CannotBeWoundBackAsAPipeCannot)
{
    FILE* const stream = openStream("text");
    EXPECT_EQ(std::fseek(stream, 0, SEEK_SET), -1);
    EXPECT_EQ(errno, ESPIPE);
    EXPECT_EQ(std::fgetc(stream), 't');
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, CannotBeWrittenAndHasNoDescriptor)
{
    FILE* const stream = openStream("text");
    EXPECT_EQ(std::fputc('x', stream), EOF);
    EXPECT_EQ(fileno(stream), -1);
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, ClosesOnlyItsOwn)
{
    FILE* const other = std::tmpfile();
    EXPECT_FALSE(closeStream(other));
    EXPECT_EQ(std::fclose(other), 0);
}

TEST(AccelStream, IsForgottenWhenFcloseClosesIt)
{
    FILE* volatile stream = openStream("text"); // volatile: newer compilers refuse such a use
    EXPECT_EQ(std::fclose(stream), 0);
    EXPECT_FALSE(closeStream(stream));
}

TEST(AccelStream, MayBeClosedHalfRead)
{
    FILE* const stream = openStream(std::string(100000, 'x'));
    EXPECT_EQ(std::fgetc(stream), 'x');
    EXPECT_TRUE(closeStream(stream));
}

TEST(AccelStream, ServesManyThreadsAtOnce)
{
    auto const use = [](char character) {
        std::string const text(10000, character);
        for (int i = 0; i < 300; ++i) {
            FILE* const stream = openStream(text);
            EXPECT_EQ(bothways::readAll(stream), text);
            if (i % 2 == 0)
                EXPECT_TRUE(closeStream(stream));
            else
                std::fclose(stream);
        }
    };
    std::vector<std::thread> threads;
    for (char const character : {'a', 'b', 'c', 'd'})
        threads.emplace_back(use, character);
    for (std::thread& thread : threads)
        thread.join();
}

} // namespace
