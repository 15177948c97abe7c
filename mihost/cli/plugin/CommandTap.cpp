#include "mihost/cli/plugin/CommandTap.h"

#include "mihost/cli/system/BoundedText.h"
#include "mihost/cli/system/DrainedPipe.h"
#include "mihost/sandbox/Descriptor.h"

#include <array>
#include <cerrno>
#include <dlfcn.h>
#include <fcntl.h>
#include <memory>
#include <set>
#include <system_error>

namespace mihost::commandTap
{

namespace
{

template <class Function> Function* next(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

struct Note {
    std::string line;
    BoundedText output;
    int status;
};

struct State {
    Runner runner{next<Runner::Open>("popen"), next<Runner::Close>("pclose")};
    Guard* guard = nullptr;
    unsigned int count = 0;
    bool recording = false;
    std::vector<std::shared_ptr<Note>> recorded;
    std::set<std::FILE*> noting; // streams whose output is noted
    int status = 0;              // of the command whose noting stream was closed last
    std::unique_ptr<DrainedPipe> standardError;
};

State& state()
{
    static State tapped;
    return tapped;
}

/** Makes a descriptor refer to another file while it exists. */
class Redirection
{
public:
    Redirection(int descriptor, int replacement)
        : descriptor_(descriptor), before_(fcntl(descriptor, F_DUPFD_CLOEXEC, 3))
    {
        if (replacement >= 0)
            dup2(replacement, descriptor_);
    }
    ~Redirection()
    {
        if (before_)
            dup2(before_.get(), descriptor_);
        else
            ::close(descriptor_); // it was not open
    }
    Redirection(Redirection const&) = delete;
    Redirection& operator=(Redirection const&) = delete;

private:
    int descriptor_;
    Descriptor before_;
};

/** @return negative without a pipe: commands then share this program's standard error */
int standardErrorEnd()
{
    try {
        if (!state().standardError)
            state().standardError = std::make_unique<DrainedPipe>();
        return state().standardError->writeEnd();
    } catch (std::system_error const&) {
        return -1;
    }
}

std::FILE* start(char const* line, char const* mode)
{
    Descriptor const nothing(::open("/dev/null", O_RDONLY | O_CLOEXEC));
    std::fflush(stderr);
    Redirection const input(STDIN_FILENO, nothing.get());
    Redirection const complaints(STDERR_FILENO, standardErrorEnd());
    return state().runner.open(line, mode);
}

/** Reads the stream to its end. */
void readInto(BoundedText& text, std::FILE* stream)
{
    std::array<char, 4096> block{};
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        text.append({block.data(), length});
}

/** A stream of the plug-in's, which reads the command's own. */
struct NotingStream {
    std::FILE* command;
    std::shared_ptr<Note> note;
};

ssize_t readNoting(void* cookie, char* buffer, std::size_t size)
{
    auto const& stream = *static_cast<NotingStream*>(cookie);
    std::size_t const length = std::fread(buffer, 1, size, stream.command);
    stream.note->output.append({buffer, length});
    return length == 0 && std::ferror(stream.command) != 0 ? -1 : static_cast<ssize_t>(length);
}

int closeNoting(void* cookie)
{
    std::unique_ptr<NotingStream> const stream(static_cast<NotingStream*>(cookie));
    readInto(stream->note->output, stream->command);
    // cppcheck-suppress AssignmentAddressToInteger ; it takes the call for the function
    stream->note->status = state().runner.close(stream->command);
    state().status = stream->note->status;
    return 0;
}

std::FILE* note(char const* line, std::FILE* running)
{
    auto const& noted = state().recorded.emplace_back(std::make_shared<Note>(Note{line, {}, 0}));
    auto stream = std::make_unique<NotingStream>(NotingStream{running, noted});
    std::FILE* const noting =
        fopencookie(stream.get(), "r", {readNoting, nullptr, nullptr, closeNoting});
    if (!noting)
        return running;
    static_cast<void>(stream.release()); // closeNoting deletes it
    state().noting.insert(noting);
    return noting;
}

} // namespace

void setRunner(Runner const& runner)
{
    state().runner = runner;
}

void setGuard(Guard* guard)
{
    state().guard = guard;
}

unsigned int count()
{
    return state().count;
}

Recording::Recording()
{
    state().recorded.clear();
    state().recording = true;
}

Recording::~Recording()
{
    state().recording = false;
}

std::vector<RunCommand> Recording::commands() const
{
    std::vector<RunCommand> commands;
    for (auto const& note : state().recorded)
        commands.push_back({note->line, note->output.text(), note->status});
    return commands;
}

std::string takeStandardError()
{
    return state().standardError ? state().standardError->take() : "";
}

std::string outputOf(std::string const& line)
{
    std::FILE* const running = start(line.c_str(), "r");
    if (!running)
        return "";
    BoundedText output;
    readInto(output, running);
    state().runner.close(running);
    return output.text();
}

std::FILE* open(char const* line, char const* mode)
{
    State& tapped = state();
    if (tapped.guard && !tapped.guard(line)) {
        errno = EPERM;
        return nullptr;
    }
    ++tapped.count;
    std::FILE* const running = start(line, mode);
    // A stream that the plug-in closed as an ordinary file may come back as another one.
    tapped.noting.erase(running);
    return running && tapped.recording ? note(line, running) : running;
}

int close(std::FILE* stream)
{
    if (state().noting.erase(stream) == 0)
        // cppcheck-suppress CastAddressToIntegerAtReturn ; as above
        return state().runner.close(stream);
    std::fclose(stream);
    return state().status;
}

} // namespace mihost::commandTap
