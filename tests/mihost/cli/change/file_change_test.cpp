// How changed files are shown.

#include "mihost/cli/change/FileChange.h"
#include "mihost/cli/change/SandboxChanges.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

namespace file_change_test
{

using mihost::FileChange;
using mihost::FileState;
using mihost::PathChange;
using mihost::Secrets;

constexpr mode_t file = S_IFREG;

std::string shown(std::vector<FileChange> const& changes)
{
    char* text = nullptr;
    std::size_t size = 0;
    std::FILE* const stream = open_memstream(&text, &size);
    mihost::Output out(stream);
    mihost::writeText(changes, out);
    std::fclose(stream);
    std::string const result(text, size);
    std::free(text);
    return result;
}

std::string shown(std::vector<PathChange> const& changes, Secrets secrets = Secrets::Hide)
{
    return shown(mihost::shownChanges(changes, "/tmp/own", secrets));
}

FileState state(mode_t mode, uid_t owner = 0, gid_t group = 0)
{
    return {mode, owner, group, ""};
}

PathChange texts(std::string const& path, std::string const& before, std::string const& after,
                 mode_t mode = 0644)
{
    return {path, state(file | mode), state(file | mode), before, after};
}

TEST(MissingLines, AreCountedAndInOrder)
{
    EXPECT_EQ(mihost::missingIn({"b", "a", "a", "c"}, {"a", "c"}), (Lines{"b", "a"}));
    EXPECT_EQ(mihost::missingIn({"a"}, {"a", "a"}), Lines());
    EXPECT_EQ(mihost::missingIn({}, {"a"}), Lines());
}

TEST(HideHash, KeepsWhatIsNotAPassword)
{
    struct Case {
        char const* record;
        std::size_t field;
        char const* hidden;
    };
    for (Case const& each : std::initializer_list<Case>{{"a:$6$s$h:1", 1, "a:(hidden):1"},
                                                        {"a:secret", 1, "a:(hidden)"},
                                                        {"a:!$6$s$h:", 1, "a:(hidden):"},
                                                        {"a:!*:1", 1, "a:!*:1"},
                                                        {"a:x:1", 1, "a:x:1"},
                                                        {"a::1", 1, "a::1"},
                                                        {"plain", 1, "plain"},
                                                        {"a:1:2:$1$x,$1$y", 3, "a:1:2:(hidden)"},
                                                        {"a:1:2", 3, "a:1:2"}}) {
        std::string record = each.record;
        mihost::hideHash(record, each.field);
        EXPECT_EQ(record, each.hidden);
    }
}

TEST(ShownChanges, SayWhatWasAddedRemovedAndChanged)
{
    EXPECT_EQ(shown(std::vector<PathChange>{
                  {"/home/new", {}, state(S_IFDIR | 0700, 1, 2), {}, {}},
                  {"/home/new/link", {}, FileState{S_IFLNK | 0777, 0, 0, "there"}, {}, {}},
                  {"/home/old", state(file | 0644), {}, {}, {}},
                  {"/home/mode", state(file | 0644), state(file | 04755), {}, {}},
                  {"/home/owner", state(file | 0644), state(file | 0644, 5, 6), {}, {}},
                  {"/home/bytes", state(file | 0644), state(file | 0644), {}, {}}}),
              "created /home/new (directory, mode 0700, owner 1:2)\n"
              "created /home/new/link (link, mode 0777, owner 0:0)\n"
              "  + -> there\n"
              "removed /home/old\n"
              "changed /home/mode (mode 0644 -> 4755)\n"
              "changed /home/owner (owner 0:0 -> 5:6)\n"
              "changed /home/bytes\n");
}

TEST(ShownChanges, SayThatTheKindOfFileChanged)
{
    EXPECT_EQ(shown(std::vector<PathChange>{{"/etc/x",
                                             state(file | 0644),
                                             FileState{S_IFLNK | 0777, 0, 0, "/etc/shadow"},
                                             {},
                                             {}}}),
              "removed /etc/x\n"
              "created /etc/x (link, mode 0777, owner 0:0)\n"
              "  + -> /etc/shadow\n");
}

TEST(ShownChanges, HaveTheLinesOfTexts)
{
    EXPECT_EQ(shown({texts("/etc/hosts", "one\ntwo\n", "two\nthree\x1b[31m\n")}),
              "changed /etc/hosts\n  - one\n  + three\\x1b[31m\n");
}

TEST(ShownChanges, HideHashesInAccountFilesAndTheirCopies)
{
    for (std::string const path : {"/etc/shadow", "/etc/gshadow", "/etc/passwd", "/etc/group"}) {
        PathChange const change = texts(path, "", "jdoe:$6$salt$hash:1::\n", 0600);
        EXPECT_EQ(shown({change}), "changed " + path + "\n  + jdoe:(hidden):1::\n");
        EXPECT_EQ(shown({change}, Secrets::Show),
                  "changed " + path + "\n  + jdoe:$6$salt$hash:1::\n");
    }
    EXPECT_EQ(shown({texts("/etc/security/opasswd", "", "jdoe:1000:1:$6$a$b,$6$c$d\n", 0600)}),
              "changed /etc/security/opasswd\n  + jdoe:1000:1:(hidden)\n");
    for (std::string const path : {"/etc/shadow-", "/etc/shadow.org", "/etc/shadow~"})
        EXPECT_EQ(mihost::shownChanges({texts(path, "", "jdoe:$6$salt$hash:1::\n", 0600)}, "",
                                       Secrets::Hide)
                      .at(0)
                      .added,
                  Lines{"jdoe:(hidden):1::"})
            << path;
}

TEST(ShownChanges, HideLinesOfOtherUnreadableFiles)
{
    PathChange const change = texts("/etc/shadowy.conf", "", "key\n", 0640);
    EXPECT_EQ(shown({change}), "changed /etc/shadowy.conf\n");
    EXPECT_EQ(shown({change}, Secrets::Show), "changed /etc/shadowy.conf\n  + key\n");
    // Nor the lines of a file that everybody may read only since the change.
    EXPECT_EQ(shown(std::vector<PathChange>{
                  {"/etc/key", state(file | 0600), state(file | 0644), "key\n", ""}}),
              "changed /etc/key (mode 0600 -> 0644)\n");
}

TEST(ShownChanges, CountTheLinesOfBackups)
{
    for (std::string const path : {"/etc/passwd-", "/etc/shadow.org", "/etc/subuid-"})
        EXPECT_EQ(shown({texts(path, "a\nb\n", "b\nc\nd\n")}),
                  "changed " + path + " (1 line removed, 2 lines added)\n");
}

TEST(ShownChanges, HaveTheLinesOfBackupsInJson)
{
    EXPECT_EQ(mihost::listToJson(
                  mihost::shownChanges({texts("/etc/passwd-", "a\n", "b\n")}, "", Secrets::Hide))
                  .dump(),
              R"([{"file":"/etc/passwd-","change":"changed","kind":"file",)"
              R"("removed":["a"],"added":["b"],"backup":true}])");
}

TEST(ShownChanges, AreNoBackupsOfFilesThatOnlyLookLikeOne)
{
    for (std::string const path : {"/home/jdoe/notes-", "/etc/hosts-", "/etc/subuid"})
        EXPECT_EQ(shown({texts(path, "1:2\n", "1:3\n")}),
                  "changed " + path + "\n  - 1:2\n  + 1:3\n");
}

TEST(ShownChanges, LeaveOutLockFilesAndTheProgramsOwnFiles)
{
    std::vector<PathChange> changes;
    for (char const* path : {"/etc/.pwd.lock", "/etc/passwd.lock", "/tmp/own/usrandpwd"})
        changes.push_back({path, {}, state(file | 0600), {}, {}});
    EXPECT_EQ(shown(changes), "");
    changes = {{"/tmp/owner", {}, state(file | 0600), {}, {}}};
    EXPECT_EQ(shown(changes), "created /tmp/owner (mode 0600, owner 0:0)\n");
}

} // namespace file_change_test
