#include "mihost/cli/shell/Shell.h"

#include "mihost/cli/input/CommandLine.h"
#include "mihost/cli/input/ShellWords.h"
#include "mihost/cli/shell/Completion.h"
#include "mihost/cli/shell/HistoryFile.h"
#include "mihost/cli/shell/LineEditor.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Sandbox.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>

namespace mihost
{

namespace
{

/** The shell's own words, in addition to the commands; both leave it. */
constexpr char const* ownWords[] = {"exit", "quit"};

bool isExit(std::vector<std::string> const& words)
{
    return words.size() == 1 &&
           std::find(std::begin(ownWords), std::end(ownWords), words[0]) != std::end(ownWords);
}

/** Names that can be typed as they are. */
bool isPlain(std::string const& name)
{
    return !name.empty() && printable(name) == name &&
           name.find_first_of(" '\"\\#") == std::string::npos;
}

} // namespace

Shell::Shell(Session& session, CommandTable const& table)
    : session_(session), table_(table), options_(session.options())
{
}

bool Shell::runLine(std::string const& line)
{
    std::vector<std::string> const words = splitWords(line);
    if (words.empty())
        return false;
    if (isExit(words))
        return true;
    CommandLine command(table_, CommandLine::Place::Shell, options_);
    command.parse(words);
    if (command.command()) {
        session_.setOptions(command.options());
        command.command()->run(session_);
        Session::warnOfUnknown();
    } else if (isDocument(command.options().format)) {
        session_.out().json({{"text", command.answer()}});
    } else {
        session_.out().write(command.answer());
    }
    session_.out().flush();
    return false;
}

void Shell::tellAsJson(Failure const& failure)
{
    session_.out().json({{"error", toJson(failure.what())}, {"exit", failure.code()}});
    session_.out().flush();
}

void Shell::runScript(std::istream& script, bool keepGoing)
{
    session_.setScripted();
    std::size_t number = 0;
    for (std::string line; std::getline(script, line);) {
        ++number;
        std::size_t const before = session_.out().size();
        session_.setOptions(options_);
        try {
            if (runLine(line))
                return;
        } catch (Failure const& failure) {
            Failure const numbered(failure.code(),
                                   fmt::format("line {}: {}", number, failure.what()));
            // A command prints a line even without a result.
            if (session_.out().takesDocuments() && session_.out().size() == before)
                tellAsJson(numbered);
            if (!keepGoing)
                throw numbered;
            tell(numbered);
            session_.endWith(failure.code());
        }
    }
}

void Shell::runInteractively()
{
    char const* const prompt = inSandbox() ? "mihost (sandbox)> " : "mihost> ";
    LineEditor editor(prompt, [this](std::string const& line) { return candidatesFor(line); });
    HistoryFile const history(historyPath());
    for (std::string const& line : history.lines())
        editor.remember(line);
    std::string line;
    for (auto end = editor.read(line); end != LineEditor::End::Finished; end = editor.read(line)) {
        if (end == LineEditor::End::Interrupted || line.empty())
            continue;
        if (!holdsPassword(line)) {
            editor.remember(line);
            history.add(line);
        }
        session_.setOptions(options_);
        try {
            if (runLine(line))
                return;
        } catch (Failure const& failure) {
            tell(failure);
        }
    }
}

std::vector<std::string> Shell::candidatesFor(std::string const& line)
{
    auto const namesOf = [this](NodeKind const& kind) {
        std::vector<std::string> names;
        for (IC::MutableNode const* node : session_.nodes())
            if (node->getNodeType() == kind.type)
                names.push_back(addressOf(*node).substr(std::string(kind.address).size() + 1));
        names.erase(std::remove_if(names.begin(), names.end(),
                                   [](std::string const& name) { return !isPlain(name); }),
                    names.end());
        return names;
    };
    std::vector<std::string> const words = wordsBeingTyped(line);
    std::vector<std::string> candidates;
    Completion const completion = complete(words, namesOf, table_, CommandLine::Place::Shell);
    for (Candidate const& candidate : completion.candidates)
        candidates.push_back(candidate.word);
    if (words.size() == 1)
        for (std::string const word : ownWords)
            if (word.compare(0, words[0].size(), words[0]) == 0)
                candidates.push_back(word);
    return candidates;
}

} // namespace mihost
