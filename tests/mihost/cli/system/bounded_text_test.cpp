#include "mihost/cli/system/BoundedText.h"

#include <gtest/gtest.h>

namespace bounded_text_test
{

using mihost::BoundedText;

TEST(BoundedText, IsWholeUpToItsLimit)
{
    BoundedText text;
    EXPECT_EQ(text.text(), "");
    text.append("one\n");
    text.append(std::string(BoundedText::limit - 4, 'x'));
    EXPECT_EQ(text.text(), "one\n" + std::string(BoundedText::limit - 4, 'x'));
}

TEST(BoundedText, CountsWhatItDrops)
{
    BoundedText text;
    text.append(std::string(BoundedText::limit - 1, 'x'));
    text.append("yz");
    text.append("more");
    EXPECT_EQ(text.text(), std::string(BoundedText::limit - 1, 'x') + "y\n... (5 more bytes)\n");
}

TEST(BoundedText, PutsTheCountOnItsOwnLine)
{
    BoundedText text;
    text.append(std::string(BoundedText::limit - 1, 'x') + "\n");
    text.append("y");
    EXPECT_EQ(text.text(), std::string(BoundedText::limit - 1, 'x') + "\n... (1 more bytes)\n");
}

} // namespace bounded_text_test
