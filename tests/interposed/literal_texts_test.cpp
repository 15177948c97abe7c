// Which text properties are made of literals, and which of std::string.

#include "nodes/OsNode.h"
#include "tests/interposed/StandIns.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

#include <sys/utsname.h>

namespace
{

class LiteralTexts : public testing::Test
{
protected:
    LiteralTexts()
    {
        standIns() = {};
    }

    /** Property 108 of the computer's node on a machine of this name. */
    std::string computerName(std::string const& name)
    {
        libc::hooks().uname = [name](utsname* system) {
            *system = {};
            name.copy(system->nodename, sizeof system->nodename - 1);
            return 0;
        };
        frame_.createOsSwNodes();
        frame_.createRootNode();
        frame_.createComputerNodes();
        libc::hooks().uname = nullptr;
        return storedValue(*frame_.currentNode_, 108);
    }

    FakeFiles const files_;
    Frame frame_;
};

TEST_F(LiteralTexts, TheComputersNameIsNotALiteralEvenIfItIsEmpty)
{
    for (std::string const name : {"harbour", ""}) {
        EXPECT_EQ(computerName(name), "text " + name + " true");
        EXPECT_EQ(standIns().literals, Lines());
    }
}

TEST_F(LiteralTexts, AFailedMethodStoresAnEmptyLiteral)
{
    IC::OsNode node(9, 7, {7}, 17, 0);
    node.setProperty(74, {std::string("NoSuchMethod"), true});
    EXPECT_EQ(storedValue(node, 74), "text  true");
    EXPECT_EQ(standIns().literals, Lines{""});
}

TEST_F(LiteralTexts, OnlyProperty113OfAUserIsALiteral)
{
    files_.write("/etc/passwd", "anna:x:1000:100::/home/anna:/bin/sh\n");
    frame_.createUserNodes(false);
    EXPECT_EQ(standIns().literals, Lines{""});
    EXPECT_EQ(storedValue(*frame_.currentNode_, 113), "text  true");
    EXPECT_EQ(storedValue(*frame_.currentNode_, 312), "text  true");
}

} // namespace
