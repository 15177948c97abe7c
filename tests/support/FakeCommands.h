#ifndef TESTS_SUPPORT_FAKECOMMANDS_H
#define TESTS_SUPPORT_FAKECOMMANDS_H

#include "tests/interpose/Libc.h"

#include <cstdio>
#include <deque>
#include <map>
#include <optional>
#include <string>
#include <vector>

/** @return the text as a stream; unlike fmemopen, this also works with NUL bytes and no text */
FILE* streamOf(std::string const& text);

/**
 * Answers commands with given output while it exists, and records every command.
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

    /** Answers for the first runs of a command, in order; later runs get the one in answers. */
    std::map<std::string, std::deque<std::string>> first;

    /** What commands print that have no answer. */
    std::optional<std::string> otherwise;

    std::vector<std::string> ran;

    /** The requested modes, one for each command. */
    std::vector<std::string> modes;

    /** The exit status of each command, as from waitpid. */
    int status = 0;

    /** Streams returned and not closed yet. */
    int open = 0;
};

#endif
