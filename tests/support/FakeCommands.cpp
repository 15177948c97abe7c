#include "tests/support/FakeCommands.h"

FILE* streamOf(std::string const& text)
{
    FILE* const stream = std::tmpfile();
    std::fwrite(text.data(), 1, text.size(), stream);
    std::rewind(stream);
    return stream;
}

FakeCommands::FakeCommands()
{
    libc::hooks().popen = [this](char const* command, char const* mode) -> FILE* {
        ran.emplace_back(command);
        modes.emplace_back(mode);
        std::deque<std::string>& turns = first[command];
        auto const answer = answers.find(command);
        if (turns.empty() && answer == answers.end() && !otherwise)
            return nullptr;
        ++open;
        if (turns.empty())
            return streamOf(answer == answers.end() ? *otherwise : answer->second);
        std::string const output = turns.front();
        turns.pop_front();
        return streamOf(output);
    };
    libc::hooks().pclose = [this](FILE* stream) {
        --open;
        std::fclose(stream);
        return status;
    };
}

FakeCommands::~FakeCommands()
{
    libc::hooks().popen = nullptr;
    libc::hooks().pclose = nullptr;
}
