// The changes that a copy of the machine reports, on top of the machine's own files.

#include "mihost/sandbox/Changes.h"
#include "tests/sandbox/border/Caller.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace changes_test
{

namespace fs = std::filesystem;
using mihost::CopyState;
using mihost::FileState;
using mihost::PathChange;

std::string shown(std::optional<FileState> const& state)
{
    if (!state)
        return "-";
    char text[64];
    std::snprintf(text, sizeof text, "%o:%u:%u", state->mode, state->owner, state->group);
    return text + (state->target.empty() ? "" : ">" + state->target);
}

/** One line for each change: the path below the directory, the state before, the state after. */
std::string shown(std::vector<PathChange> const& changes, std::string const& folder)
{
    std::string text;
    for (PathChange const& change : changes) {
        bool const isBelow = change.path.rfind(folder + "/", 0) == 0;
        text += (isBelow ? change.path.substr(folder.size() + 1) : change.path) + ' ' +
                shown(change.before) + ' ' + shown(change.after) + '\n';
    }
    return text;
}

class Changes : public BorderTest
{
protected:
    void SetUp() override
    {
        BorderTest::SetUp();
        umask(022);
        folder_.write("file", "text");
        folder_.write("home/one", "1");
        folder_.write("home/sub/two", "2");
        fs::create_symlink("file", folder_.path("link"));
    }

    /** The changes that a copy reports after an act in it. */
    std::string changesOf(
        std::function<void()> const& act, std::function<void()> const& earlier = [] {},
        std::function<void()> const& before = [] {}) const
    {
        Caller caller(
            [&] {
                fs::current_path(folder_.name());
                earlier();
                CopyState const state = CopyState::read();
                act();
                Caller::say(shown(state.changesTo(CopyState::read()), folder_.name()));
                return 0;
            },
            "", before);
        std::string said = caller.hearAll();
        EXPECT_EQ(caller.wait(), 0);
        return said;
    }

    ScratchFolder const folder_;
};

TEST_F(Changes, AreNoneIfNothingIsDone)
{
    EXPECT_EQ(changesOf([] { contentOf("file"); }), "");
}

TEST_F(Changes, NameCreatedAndRemovedFiles)
{
    EXPECT_EQ(changesOf([] {
                  fs::create_directories("new/deep");
                  std::ofstream("new/deep/file") << "x";
                  fs::create_symlink("/target", "new/link");
                  mkfifo("new/pipe", 0600);
                  fs::remove("file");
                  fs::remove_all("home");
              }),
              "file 100644:0:0 -\n"
              "home 40755:0:0 -\n"
              "home/one 100644:0:0 -\n"
              "home/sub 40755:0:0 -\n"
              "home/sub/two 100644:0:0 -\n"
              "new - 40755:0:0\n"
              "new/deep - 40755:0:0\n"
              "new/deep/file - 100644:0:0\n"
              "new/link - 120777:0:0>/target\n"
              "new/pipe - 10600:0:0\n");
}

TEST_F(Changes, NameFilesWithNewContentModeOrOwner)
{
    EXPECT_EQ(changesOf([] {
                  std::ofstream("file") << "Text"; // as long as before
                  chmod("home", 0700);
                  EXPECT_EQ(chown("home/one", 12, 34), 0);
                  fs::remove("link");
                  fs::create_symlink("home", "link");
              }),
              "file 100644:0:0 100644:0:0\n"
              "home 40755:0:0 40700:0:0\n"
              "home/one 100644:0:0 100644:12:34\n"
              "link 120777:0:0>file 120777:0:0>home\n");
}

TEST_F(Changes, ExcludeWritesOfTheSameContent)
{
    EXPECT_EQ(changesOf([] {
                  std::ofstream("file") << "text";
                  fs::last_write_time("home/one", fs::file_time_type::clock::now());
                  chmod("home", 0700);
                  chmod("home", 0755);
                  std::ofstream("home/sub/passing") << "x";
                  fs::remove("home/sub/passing");
              }),
              "");
}

TEST_F(Changes, ExcludeEarlierChanges)
{
    auto const earlier = [] {
        std::ofstream("file") << "earlier";
        std::ofstream("home/new") << "earlier";
        fs::remove("home/one");
        fs::remove_all("home/sub");
    };
    EXPECT_EQ(changesOf([] {}, earlier), "");
    EXPECT_EQ(changesOf(
                  [] {
                      std::ofstream("file") << "later, longer";
                      std::ofstream("home/one") << "later";
                      fs::remove("home/new");
                  },
                  earlier),
              "file 100644:0:0 100644:0:0\n"
              "home/new 100644:0:0 -\n"
              "home/one - 100644:0:0\n");
}

TEST_F(Changes, ShowADirectoryThatWasMadeAgain)
{
    EXPECT_EQ(changesOf([] {
                  fs::remove_all("home");
                  fs::create_directory("home");
                  std::ofstream("home/three") << "3";
              }),
              "home/one 100644:0:0 -\n"
              "home/sub 40755:0:0 -\n"
              "home/sub/two 100644:0:0 -\n"
              "home/three - 100644:0:0\n");
}

TEST_F(Changes, ShowADirectoryThatWasMoved)
{
    EXPECT_EQ(changesOf([] { EXPECT_EQ(std::system("mv home house"), 0); }),
              "home 40755:0:0 -\n"
              "home/one 100644:0:0 -\n"
              "home/sub 40755:0:0 -\n"
              "home/sub/two 100644:0:0 -\n"
              "house - 40755:0:0\n"
              "house/one - 100644:0:0\n"
              "house/sub - 40755:0:0\n"
              "house/sub/two - 100644:0:0\n");
}

TEST_F(Changes, ShowAFileThatReplacesADirectory)
{
    EXPECT_EQ(changesOf([] {
                  fs::remove_all("home");
                  std::ofstream("home") << "file";
              }),
              "home 40755:0:0 100644:0:0\n"
              "home/one 100644:0:0 -\n"
              "home/sub 40755:0:0 -\n"
              "home/sub/two 100644:0:0 -\n");
}

TEST_F(Changes, AreFoundOnEveryFileSystem)
{
    fs::create_directory(folder_.path("disk"));
    auto const mountDisk = [this] {
        mountOwnDisk(folder_.path("disk"));
        folder_.write("disk/file", "x");
    };
    EXPECT_EQ(changesOf(
                  [] {
                      fs::remove("disk/file");
                      std::ofstream("disk/new") << "x";
                      fs::remove("file");
                  },
                  [] {}, mountDisk),
              "disk/file 100644:0:0 -\n"
              "disk/new - 100644:0:0\n"
              "file 100644:0:0 -\n");
}

TEST_F(Changes, IncludeTheTextOfFilesInEtc)
{
    Caller caller([this] {
        std::ofstream("/etc/oswmi-old") << "one\n";
        std::ofstream("/etc/oswmi-bytes") << std::string(3, '\0');
        CopyState const state = CopyState::read();
        std::ofstream("/etc/passwd", std::ios::app) << "x:x:1:1::/:/bin/sh\n";
        std::ofstream("/etc/oswmi-old") << "two\n";
        std::ofstream("/etc/oswmi-new") << "new\n";
        std::ofstream("/etc/oswmi-bytes") << "text\n";
        fs::remove(folder_.path("file"));
        for (PathChange const& change : state.changesTo(CopyState::read())) {
            if (change.path == "/etc/passwd")
                Caller::say(*change.newText == *change.oldText + "x:x:1:1::/:/bin/sh\n" ? "+"
                                                                                        : "?");
            else
                Caller::say(change.path + ":" + change.oldText.value_or("-") + ":" +
                            change.newText.value_or("-") + "\n");
        }
        return 0;
    });
    EXPECT_EQ(caller.hearAll(), "/etc/oswmi-bytes:-:-\n/etc/oswmi-new::new\n\n"
                                "/etc/oswmi-old:one\n:two\n\n+" +
                                    folder_.path("file") + ":-:-\n");
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Changes, LeaveNoDescriptorThatReachesTheMachine)
{
    std::string const file = folder_.path("file");
    Caller caller([&file] {
        for (auto const& entry : fs::directory_iterator("/proc/self/fd")) {
            std::ofstream stream(entry.path() / file.substr(1));
            if (stream << "after" && stream.flush())
                Caller::say(entry.path());
            fs::path const upper = entry.path() / "new";
            if (std::ofstream(upper) << "x" && exists(upper))
                Caller::say(upper);
        }
        return 0;
    });
    EXPECT_EQ(caller.hearAll(), "");
    EXPECT_EQ(contentOf(file), "text");
}

} // namespace changes_test
