#ifndef MIHOST_CLI_SHELL_COMPLETION_H
#define MIHOST_CLI_SHELL_COMPLETION_H

#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/input/CommandLine.h"

#include <functional>
#include <string>
#include <vector>

/** What may come next in a command line that is being typed. */
namespace mihost
{

struct Candidate {
    std::string word; // the whole word; incomplete if it ends in ':' or '='
    std::string note; // its meaning, on one line; may be empty
};

struct Completion {
    enum class What { Words, Files, Folders };

    What what = What::Words;
    std::vector<Candidate> candidates; // none for files and folders
};

/**
 * The names of a kind's nodes, such as login names for users. Names that contain control characters
 * or bytes that are not UTF-8 are not offered.
 */
using NodeNames = std::function<std::vector<std::string>(NodeKind const& kind)>;

/**
 * @param words  a command line without the program's name; the last word is the one being typed and
 *               may be empty
 */
Completion complete(std::vector<std::string> const& words, NodeNames const& names,
                    CommandTable const& table,
                    CommandLine::Place place = CommandLine::Place::Program);

/**
 * What a shell's completion script reads: a line with words, files or folders, then a line for each
 * candidate, followed by a tab and its note if it has one.
 */
std::string completionText(Completion const& completion);

} // namespace mihost

#endif
