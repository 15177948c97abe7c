#include "mihost/cli/shell/LineEditor.h"

#include "mihost/cli/input/ShellWords.h"
#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/shell/HistoryFile.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/Stderr.h"
#include "mihost/sandbox/Sandbox.h"

#include <algorithm>
#include <csignal>
#include <cwchar>
#include <fcntl.h>
#include <fmt/format.h>
#include <sys/ioctl.h>
#include <unistd.h>
#include <utility>

namespace mihost
{

namespace
{

constexpr char ctrlD = '\x04';

bool goesOn(std::string const& word)
{
    return !word.empty() && (word.back() == ':' || word.back() == '=');
}

} // namespace

LineEditor::LineEditor(char const* prompt, Completer completer)
    : prompt_(prompt), completer_(std::move(completer)),
      screen_(fdopen(fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 3), "w")), history_(history_init())
{
    tcgetattr(STDIN_FILENO, &settings_);
    if (screen_ && history_) // results alone go to standard output
        editor_.reset(el_init("mihost", stdin, screen_.get(), stderr));
    if (!editor_)
        throw Failure(BadUsage, "the terminal cannot be used for editing lines");
    HistEvent event;
    history(history_.get(), &event, H_SETSIZE, historyLimit);
    history(history_.get(), &event, H_SETUNIQUE, 1);
    EditLine* const editor = editor_.get();
    el_set(editor, EL_CLIENTDATA, this);
    el_set(editor, EL_EDITOR, "emacs");
    // On Ctrl-C the kernel would drop pending output to the terminal, perhaps the next prompt.
    el_set(editor, EL_SETTY, "-d", "+noflsh", nullptr);
    el_set(editor, EL_PROMPT, &LineEditor::promptOf);
    el_set(editor, EL_HIST, history, history_.get());
    el_set(editor, EL_GETCFN, &LineEditor::getCharacter);
    el_set(editor, EL_ADDFN, "mihost-complete", "complete the word", &LineEditor::completeWord);
    el_set(editor, EL_BIND, "^I", "mihost-complete", nullptr);
    el_set(editor, EL_BIND, "^R", "em-inc-search-prev", nullptr);
}

LineEditor::~LineEditor() = default;

LineEditor& LineEditor::of(EditLine* editor)
{
    void* self = nullptr;
    el_get(editor, EL_CLIENTDATA, &self);
    return *static_cast<LineEditor*>(self);
}

char* LineEditor::promptOf(EditLine* editor)
{
    return of(editor).prompt_.data();
}

/** Reads one character, since the library would not end or redraw the line on signals. */
int LineEditor::getCharacter(EditLine* editor, wchar_t* character)
{
    LineEditor& self = of(editor);
    std::mbstate_t state{};
    for (;;) {
        auto const event = self.signals_->wait({STDIN_FILENO, POLLIN, 0}, -1);
        if (event == SignalWaiter::Event::Signal)
            self.obey(self.signals_->signal());
        if (self.interrupted_)
            return -1;
        if (event != SignalWaiter::Event::Ready)
            continue;
        char byte = 0;
        ssize_t const count = ::read(STDIN_FILENO, &byte, 1);
        if (count <= 0)
            return static_cast<int>(count);
        // Ctrl-D typed while a command runs ends a line of the terminal, which keeps it as a NUL.
        bool const isEarlyEnd = byte == '\0' && self.typedBefore_ > 0;
        self.typedBefore_ = std::max(self.typedBefore_ - 1, 0);
        if (isEarlyEnd)
            byte = ctrlD;
        std::size_t const taken = std::mbrtowc(character, &byte, 1, &state);
        if (taken == static_cast<std::size_t>(-2))
            continue; // more bytes belong to it
        if (taken == static_cast<std::size_t>(-1))
            *character = static_cast<unsigned char>(byte);
        return 1;
    }
}

void LineEditor::obey(int signal)
{
    interrupted_ = signal == SIGINT;
    if (signal == SIGWINCH)
        el_resize(editor_.get());
    if (signal != SIGTSTP)
        return;
    // While stopped, another process owns the terminal; afterwards the line is shown again. In the
    // sandbox, whose outer process stops as well, another process may own it already.
    if (!inSandbox())
        el_set(editor_.get(), EL_PREP_TERM, 0);
    raise(SIGSTOP);
    el_set(editor_.get(), EL_PREP_TERM, 0);
    el_set(editor_.get(), EL_PREP_TERM, 1);
    el_set(editor_.get(), EL_REFRESH);
}

unsigned char LineEditor::completeWord(EditLine* editor, int)
{
    LineInfo const* const line = el_line(editor);
    std::string const before(line->buffer, line->cursor);
    LineEditor& self = of(editor);
    return self.offer(self.completer_(before), wordsBeingTyped(before).back());
}

unsigned char LineEditor::offer(std::vector<std::string> const& candidates,
                                std::string const& typed)
{
    if (candidates.empty())
        return CC_REFRESH_BEEP;
    std::string const start = commonStart(candidates);
    std::string rest = start.substr(std::min(typed.size(), start.size()));
    if (candidates.size() == 1 && !goesOn(start))
        rest += ' ';
    if (!rest.empty()) {
        el_insertstr(editor_.get(), rest.c_str());
        return CC_REFRESH;
    }
    writeStderr("\n" + inColumns(candidates, terminal::width(STDERR_FILENO)));
    return CC_REDISPLAY;
}

LineEditor::End LineEditor::read(std::string& line)
{
    signals_.emplace(std::vector<int>{SIGWINCH, SIGTSTP});
    interrupted_ = false;
    interrupts::setTerminalToRestore(&settings_);
    // It would show the prompt first; text typed in between would be misread.
    el_set(editor_.get(), EL_PREP_TERM, 1);
    if (ioctl(STDIN_FILENO, FIONREAD, &typedBefore_) != 0)
        typedBefore_ = 0;
    int length = 0;
    char const* const text = el_gets(editor_.get(), &length);
    interrupts::setTerminalToRestore(nullptr);
    signals_.reset();
    if (interrupted_) {
        writeStderr("\n");
        return End::Interrupted;
    }
    if (!text || length <= 0) {
        writeStderr("\n");
        return End::Finished;
    }
    line.assign(text, static_cast<std::size_t>(length));
    if (!line.empty() && line.back() == '\n')
        line.pop_back();
    return End::Line;
}

void LineEditor::remember(std::string const& line)
{
    HistEvent event;
    history(history_.get(), &event, H_ENTER, line.c_str());
}

std::string inColumns(std::vector<std::string> const& words, std::size_t width)
{
    constexpr std::size_t most = 200;
    constexpr std::size_t gap = 2;
    std::size_t widest = gap;
    std::size_t const count = std::min(words.size(), most);
    for (std::size_t at = 0; at < count; ++at)
        widest = std::max(widest, displayWidth(words[at]) + gap);
    std::size_t const columns = std::max<std::size_t>(width / widest, 1);
    std::string text;
    for (std::size_t at = 0; at < count; ++at) {
        bool const isLast = at + 1 == count || at % columns + 1 == columns;
        text += words[at];
        text += isLast ? "\n" : std::string(widest - displayWidth(words[at]), ' ');
    }
    if (words.size() > most)
        text += fmt::format("and {} more\n", words.size() - most);
    return text;
}

std::string commonStart(std::vector<std::string> const& candidates)
{
    if (candidates.empty())
        return "";
    std::string start = candidates.front();
    for (std::string const& candidate : candidates) {
        auto const [end, ignored] =
            std::mismatch(start.begin(), start.end(), candidate.begin(), candidate.end());
        start.erase(end, start.end());
    }
    return start;
}

} // namespace mihost
