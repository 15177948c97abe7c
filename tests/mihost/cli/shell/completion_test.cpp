#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/shell/Completion.h"

#include "host/Properties.h"

#include <gtest/gtest.h>

namespace completion_test
{

using namespace mihost;
using Words = std::vector<std::string>;

Words namesOf(NodeKind const& kind)
{
    switch (kind.type) {
    case IC::nodeType::user:
        return {"root", "jdoe"};
    case IC::nodeType::group:
        return {"staff"};
    default:
        return {};
    }
}

Words wordsOf(Completion const& completion)
{
    Words words;
    for (Candidate const& candidate : completion.candidates)
        words.push_back(candidate.word);
    return words;
}

Words after(Words const& words)
{
    return wordsOf(complete(words, namesOf, mihost::commandTable()));
}

Completion::What kindAfter(Words const& words)
{
    return complete(words, namesOf, mihost::commandTable()).what;
}

TEST(Completion, BeginsWithTheCommands)
{
    Words const commands = after({""});
    ASSERT_GE(commands.size(), 2U);
    EXPECT_EQ(commands[0], "tree");
    EXPECT_EQ(after({"ge"}), Words{"get"});
    EXPECT_EQ(after({"--json", "ge"}), Words{"get"});
    EXPECT_EQ(after({}), commands);
}

TEST(Completion, KnowsNothingAfterAnUnknownCommandOrOption)
{
    EXPECT_EQ(after({"nonsense", ""}), Words());
    EXPECT_EQ(after({"--nonsense", ""}), Words());
    EXPECT_EQ(after({"nonsense", "get", ""}), Words());
    EXPECT_EQ(after({"--nonsense", "--json", "get", ""}), Words());
}

TEST(Completion, OffersTheOptionsOfTheCommandAndThoseOfAll)
{
    EXPECT_EQ(after({"list", "--colu"}), Words{"--columns"});
    EXPECT_EQ(after({"list", "--js"}), Words{"--json"});
    EXPECT_EQ(after({"--js"}), Words{"--json"});
    EXPECT_EQ(after({"--colu"}), Words());
    EXPECT_EQ(after({"list", "--help"}), (Words{"--help", "--help-all"}));
}

TEST(Completion, ContinuesAfterAnOptionWithItsValue)
{
    for (char const* option : {"--host", "-H"}) {
        EXPECT_EQ(after({option, "box", "ge"}), Words{"get"});
        EXPECT_EQ(after({option, "ge"}), Words());
    }
    EXPECT_EQ(after({"--plugin", "file", "ge"}), Words{"get"});
    EXPECT_EQ(after({"--plugin=file", "ge"}), Words{"get"});
    EXPECT_EQ(after({"watch", "-n", ""}), Words());
    EXPECT_EQ(after({"watch", "-n", "5", "lo"}), (Words{"log", "log:"}));
    EXPECT_EQ(after({"watch", "-n5", "lo"}), (Words{"log", "log:"}));
    EXPECT_EQ(after({"-y", "power", "h"}), Words{"halt"});
    EXPECT_EQ(after({"-x5", "power", "h"}), Words());
}

TEST(Completion, LeavesFilesAndDirectoriesToTheShell)
{
    EXPECT_EQ(kindAfter({"--plugin", ""}), Completion::What::Files);
    EXPECT_EQ(kindAfter({"get", "--trace", "x"}), Completion::What::Files);
    EXPECT_EQ(kindAfter({"--overlay", ""}), Completion::What::Folders);
    EXPECT_EQ(kindAfter({"--plugin=", ""}), Completion::What::Words);
    EXPECT_EQ(kindAfter({"check", ""}), Completion::What::Files);
    EXPECT_EQ(after({"check", "--format", ""}), (Words{"text", "tap", "junit"}));
    EXPECT_EQ(after({"check", "--r"}), Words{"--rounds"});
}

TEST(Completion, OffersNodesAsTheyAreAddressed)
{
    EXPECT_EQ(after({"get", ""}),
              (Words{"mi", "root", "computer", "os", "driver:", "user:", "group:", "log", "log:"}));
    EXPECT_EQ(after({"get", "lo"}), (Words{"log", "log:"}));
    EXPECT_EQ(after({"get", "user:"}), (Words{"user:root", "user:jdoe"}));
    EXPECT_EQ(after({"get", "user:j"}), Words{"user:jdoe"});
    EXPECT_EQ(after({"tree", "group:"}), Words{"group:staff"});
}

TEST(Completion, OffersThePropertiesOfTheNodesKind)
{
    EXPECT_EQ(after({"get", "user:root", "password-m"}),
              (Words{"password-max-days", "password-min-days"}));
    EXPECT_EQ(after({"get", "os", "os-name", "os-v"}), Words{"os-version"});
    EXPECT_EQ(after({"watch", "os", "os-v"}), Words{"os-version"});
    EXPECT_EQ(after({"get", "17", "os-v"}), Words());
    EXPECT_EQ(after({"get", "no:such", "os-v"}), Words());
}

TEST(Completion, OffersTheValuesOfABoolean)
{
    EXPECT_EQ(after({"set", "user:root", "delete", ""}), (Words{"true", "false"}));
    EXPECT_EQ(after({"set", "os", "refresh", ""}), Words());
    EXPECT_EQ(after({"set", "os", "refresh", "0", ""}), Words());
}

TEST(Completion, OffersMethodsAndTheirParametersOnce)
{
    EXPECT_EQ(after({"call", "UserD"}), Words{"UserDel"});
    EXPECT_EQ(after({"call", "UserDel", ""}), Words{"UserName="});
    EXPECT_EQ(after({"call", "NoMethod", ""}), Words());
    EXPECT_EQ(after({"call", "LocalGroupAddUser", "LocalGroupName=staff", ""}),
              Words{"DomainAndMember="});
    EXPECT_EQ(after({"call", "UserSetPassword", "P"}), Words{"Password=-"});
    EXPECT_EQ(after({"call", "UserSetPassword", "Password=-", ""}), Words{"UserName="});
    EXPECT_EQ(after({"set", "user:root", "password", ""}), Words{"-"});
}

TEST(Completion, OffersTheAccountsThatAParameterNames)
{
    EXPECT_EQ(after({"call", "UserDel", "UserName="}), (Words{"UserName=root", "UserName=jdoe"}));
    EXPECT_EQ(after({"call", "LocalGroupDelUser", "DomainAndMember=j"}),
              Words{"DomainAndMember=jdoe"});
    EXPECT_EQ(after({"call", "LocalGroupDelUser", "LocalGroupName="}),
              Words{"LocalGroupName=staff"});
    EXPECT_EQ(after({"call", "LocalGroupDel", "GroupName="}), Words{"GroupName=staff"});
    EXPECT_EQ(after({"call", "UserAdd", "UserName="}), Words());
    EXPECT_EQ(after({"call", "LocalGroupAdd", "GroupName="}), Words());
}

TEST(Completion, OffersTheWordsThatAnArgumentAccepts)
{
    EXPECT_EQ(after({"power", ""}), (Words{"restart", "halt"}));
    EXPECT_EQ(after({"list", "u"}), Words{"users"});
    EXPECT_EQ(after({"properties", "log"}), (Words{"log", "log-entry"}));
    EXPECT_EQ(after({"help", "po"}), Words{"power"});
    EXPECT_EQ(after({"help", "power", ""}), Words());
    EXPECT_EQ(after({"help", "nonsense", ""}), Words());
    EXPECT_EQ(after({"tree", "-o", "js"}), (Words{"json", "jsonl"}));
    EXPECT_EQ(after({"--color=ne"}), Words{"--color=never"});
}

TEST(Completion, OffersTheTasksAndTheAccountsThatACommandShows)
{
    EXPECT_EQ(after({"user", "d"}), Words{"delete"});
    EXPECT_EQ(after({"user", "j"}), Words{"jdoe"});
    EXPECT_EQ(after({"group", ""}),
              (Words{"staff", "add", "delete", "add-member", "remove-member"}));
    EXPECT_EQ(after({"group", "s"}), Words{"staff"});
    EXPECT_EQ(after({"user", "--", "d"}), Words());
    EXPECT_EQ(after({"help", "user", "del"}), Words{"delete"});
}

TEST(Completion, OffersTheValuesOfTasks)
{
    EXPECT_EQ(after({"user", "delete", ""}), (Words{"root", "jdoe"}));
    EXPECT_EQ(after({"user", "add", ""}), Words());
    EXPECT_EQ(after({"group", "add-member", "staff", "j"}), Words{"jdoe"});
    EXPECT_EQ(after({"user", "age", "--max"}), Words{"--max-days"});
    EXPECT_EQ(after({"user", "add", "--js"}), Words{"--json"});
    EXPECT_EQ(after({"user", "delete", "jdoe", ""}), Words());
    EXPECT_EQ(kindAfter({"user", "add", "--shell", ""}), Completion::What::Files);
    EXPECT_EQ(kindAfter({"user", "set-home", "jdoe", ""}), Completion::What::Folders);
}

TEST(Completion, OffersColumnsToShowOrderAndChooseBy)
{
    EXPECT_EQ(after({"list", "groups", "--sort", "-group-n"}), Words{"-group-name"});
    EXPECT_EQ(after({"list", "groups", "--where", "group-n"}), Words{"group-name="});
    EXPECT_EQ(after({"list", "groups", "--where", "group-name=g"}), Words());
    EXPECT_EQ(after({"list", "users", "--columns", "user-name,full"}),
              Words{"user-name,full-name"});
    EXPECT_EQ(after({"list", "users", "--columns=full"}), Words{"--columns=full-name"});
    EXPECT_EQ(after({"list", "--columns", "full"}), Words());
}

TEST(Completion, TreatsWhatFollowsTwoDashesAsArguments)
{
    EXPECT_EQ(after({"get", "--", "o"}), Words{"os"});
    EXPECT_EQ(after({"get", "--", "--js"}), Words());
}

TEST(CompletionText, HasALineForEachCandidateWithItsNote)
{
    EXPECT_EQ(completionText({Completion::What::Words, {{"os", "the system"}, {"user:joe", ""}}}),
              "words\nos\tthe system\nuser:joe\n");
    EXPECT_EQ(completionText({Completion::What::Files, {}}), "files\n");
    EXPECT_EQ(completionText({Completion::What::Folders, {}}), "folders\n");
}

} // namespace completion_test
