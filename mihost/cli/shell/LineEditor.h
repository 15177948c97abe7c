#ifndef MIHOST_CLI_SHELL_LINEEDITOR_H
#define MIHOST_CLI_SHELL_LINEEDITOR_H

#include "mihost/cli/system/SignalWaiter.h"
#include "mihost/sandbox/OwnedStream.h"

#include <functional>
#include <histedit.h>
#include <memory>
#include <optional>
#include <string>
#include <termios.h>
#include <vector>

namespace mihost
{

/** Reads lines that a person types, with editing, history and completion. */
class LineEditor
{
public:
    /** The completions of the last word of a line; those ending in ':' or '=' are incomplete. */
    using Completer = std::function<std::vector<std::string>(std::string const& line)>;

    enum class End { Line, Interrupted, Finished };

    /** @param prompt  must outlive the editor */
    LineEditor(char const* prompt, Completer completer);
    ~LineEditor();
    LineEditor(LineEditor const&) = delete;
    LineEditor& operator=(LineEditor const&) = delete;

    /** Reads a line, without its end. */
    End read(std::string& line);

    /** Puts a line into the history. */
    void remember(std::string const& line);

private:
    static LineEditor& of(EditLine* editor);
    static char* promptOf(EditLine* editor);
    static int getCharacter(EditLine* editor, wchar_t* character);
    static unsigned char completeWord(EditLine* editor, int key);

    void obey(int signal);
    unsigned char offer(std::vector<std::string> const& candidates, std::string const& typed);

    struct EndEditor {
        void operator()(EditLine* editor) const
        {
            el_end(editor);
        }
    };
    struct EndHistory {
        void operator()(History* history) const
        {
            history_end(history);
        }
    };

    std::optional<SignalWaiter> signals_; // while reading
    bool interrupted_ = false;
    int typedBefore_ = 0; // bytes left that were typed before the prompt
    std::string prompt_;
    Completer completer_;
    termios settings_{}; // the terminal's, outside of reading
    Stream screen_;      // standard error, written piece by piece
    std::unique_ptr<History, EndHistory> history_;
    std::unique_ptr<EditLine, EndEditor> editor_;
};

/** @return the words in columns, with line ends; of very many the first, and how many are left */
std::string inColumns(std::vector<std::string> const& words, std::size_t width);

/** @return the longest text that all candidates begin with */
std::string commonStart(std::vector<std::string> const& candidates);

} // namespace mihost

#endif
