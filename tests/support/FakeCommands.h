#ifndef TESTS_SUPPORT_FAKECOMMANDS_H
#define TESTS_SUPPORT_FAKECOMMANDS_H

#include "tests/interpose/Libc.h"

#include <deque>
#include <map>
#include <optional>
#include <string>
#include <vector>

/**
 * Answers commands with recorded output for as long as it lives, and notes every command it gets.
 *
 * A command that has no answer cannot be started: popen yields null.
 */
class FakeCommands
{
public:
    FakeCommands();
    ~FakeCommands();
    FakeCommands(FakeCommands const&) = delete;
    FakeCommands& operator=(FakeCommands const&) = delete;

    std::map<std::string, std::string> answers;

    /** Answers for the first runs of a command, in turn; later ones get that of answers. */
    std::map<std::string, std::deque<std::string>> first;

    /** What commands without an answer of their own print. */
    std::optional<std::string> otherwise;

    std::vector<std::string> ran;

    /** The requested modes, one for each command. */
    std::vector<std::string> modes;

    /** Streams returned and not closed yet. */
    int open = 0;
};

#endif
