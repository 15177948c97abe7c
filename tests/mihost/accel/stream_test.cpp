#include "tests/support/BothWays.h"

#include <gtest/gtest.h>
#include <vector>

namespace stream_test
{

using miaccel::openStream;

TEST(AccelStream, GivesItsWholeTextWithNulBytes)
{
    for (std::string const& text : {std::string(), std::string(3 * 1024 * 1024, '\0') + "\nend"}) {
        FILE* const stream = openStream(text);
        EXPECT_TRUE(bothways::readAll(stream) == text) << text.size();
        EXPECT_TRUE(std::feof(stream));
        EXPECT_FALSE(std::ferror(stream));
        EXPECT_EQ(std::fclose(stream), 0);
    }
}

TEST(AccelStream, GivesLinesAsFgetsReadsThem)
{
    FILE* const stream = openStream("first\nsecond line\nthird");
    char buffer[8];
    std::vector<std::string> pieces;
    while (std::fgets(buffer, sizeof buffer, stream))
        pieces.emplace_back(buffer);
    EXPECT_EQ(pieces, (std::vector<std::string>{"first\n", "second ", "line\n", "third"}));
    std::fclose(stream);
}

TEST(AccelStream, CannotBeRewoundOrWrittenAndHasNoDescriptor)
{
    FILE* const stream = openStream("text");
    EXPECT_EQ(std::fseek(stream, 0, SEEK_SET), -1);
    EXPECT_EQ(std::fputc('x', stream), EOF);
    EXPECT_EQ(fileno(stream), -1);
    EXPECT_EQ(std::fgetc(stream), 't');
    std::fclose(stream); // half read
}

} // namespace stream_test
