#include "mihost/cli/input/Remote.h"
#include "mihost/cli/input/ShellWords.h"
#include "tests/mihost/cli/Refusal.h"

#include <gtest/gtest.h>

namespace remote_test
{

using namespace mihost;
using Words = std::vector<std::string>;

TEST(QuotedForShell, KeepsEverythingButPlainWordsTogether)
{
    for (char const* word : {"get", "os", "user:jdoe", "--json", "/a/b.c", "x,y", "a@b"})
        EXPECT_EQ(quotedForShell(word), word);
    EXPECT_EQ(quotedForShell(""), "''");
    EXPECT_EQ(quotedForShell("a b"), "'a b'");
    EXPECT_EQ(quotedForShell("$x;`y`*"), "'$x;`y`*'");
    EXPECT_EQ(quotedForShell("it's"), "'it'\\''s'");
    EXPECT_EQ(quotedForShell("a\\b!"), "'a'\\\\'b'\\!''");
}

TEST(QuotedForShell, IsUndoneBySplittingWords)
{
    std::string word;
    for (int byte = 1; byte < 256; ++byte)
        word += static_cast<char>(byte);
    EXPECT_EQ(splitWords(quotedForShell(word)), Words{word});
}

TEST(WithoutHost, DropsTheHostInEachOfItsFormsAndNothingElse)
{
    Words const rest = {"--json", "get", "os"};
    EXPECT_EQ(withoutHost({"--host", "box", "--json", "get", "os"}, "box"), rest);
    EXPECT_EQ(withoutHost({"--host=box", "--json", "get", "os"}, "box"), rest);
    EXPECT_EQ(withoutHost({"--json", "-H", "box", "get", "os"}, "box"), rest);
    EXPECT_EQ(withoutHost({"--json", "get", "os", "-Hbox"}, "box"), rest);
    EXPECT_EQ(withoutHost({"-H", "box", "get", "box", "--", "--host", "box"}, "box"),
              (Words{"get", "box", "--", "--host", "box"}));
    EXPECT_EQ(withoutHost({"--trace", "-H", "-H", "box"}, "box"), (Words{"--trace", "-H"}));
}

TEST(WithoutHost, RefusesAHostWithinAnotherWord)
{
    EXPECT_EQ(refusal([] {
                  withoutHost({"-yH", "box", "get", "os"}, "box");
              }),
              "--host: it is part of another argument (write --host HOST separately)");
}

TEST(ExpectHost, RefusesWhatSshWouldReadAsSomethingElse)
{
    for (char const* host : {"", "-oProxyCommand=x", "a b", "a\nb"})
        EXPECT_EQ(refusal([host] { expectHost(host); }),
                  "--host: '" + std::string(host) + "' is not a host (write [USER@]HOST)");
    for (char const* host : {"box", "root@box.example", "::1", "müller.example"})
        EXPECT_EQ(refusal([host] { expectHost(host); }), "accepted") << host;
}

TEST(RemoteCommand, GivesSshOneLineForTheRemoteShell)
{
    EXPECT_EQ(remoteCommand("root@box", {"set", "os", "74", "a b"}, RemoteTerminal::None),
              (Words{"ssh", "-T", "--", "root@box", "exec mihost set os 74 'a b'"}));
    EXPECT_EQ(remoteCommand("box", {}, RemoteTerminal::Use),
              (Words{"ssh", "-t", "-o", "LogLevel=ERROR", "--", "box", "exec mihost"}));
    EXPECT_EQ(remoteCommand("box", {"tree"}, RemoteTerminal::Ignore),
              (Words{"ssh", "-T", "-n", "--", "box", "exec mihost tree"}));
}

} // namespace remote_test
