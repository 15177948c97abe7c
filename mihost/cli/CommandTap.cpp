#include "mihost/cli/CommandTap.h"

#include "mihost/sandbox/Descriptor.h"

#include <array>
#include <dlfcn.h>
#include <fcntl.h>
#include <map>
#include <sys/mman.h>

namespace mihost::commandTap
{

namespace
{

template <class Function> Function* next(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

struct State {
    Runner runner{next<Runner::Open>("popen"), next<Runner::Close>("pclose")};
    Listener* listener = nullptr;
    unsigned int count = 0;
    bool recording = false;
    std::vector<RunCommand> recorded;
    std::map<std::FILE*, int> finished; // streams of commands that have ended: the exit status
    Descriptor standardError;
};

State& state()
{
    static State tapped;
    return tapped;
}

/** Puts another file in a descriptor's place for as long as it lives. */
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

int standardErrorFile()
{
    Descriptor& file = state().standardError;
    if (!file)
        file = Descriptor(memfd_create("standard error of commands", MFD_CLOEXEC));
    return file.get();
}

std::FILE* start(char const* line, char const* mode)
{
    Descriptor const nothing(::open("/dev/null", O_RDONLY | O_CLOEXEC));
    std::fflush(stderr);
    Redirection const input(STDIN_FILENO, nothing.get());
    Redirection const complaints(STDERR_FILENO, standardErrorFile());
    return state().runner.open(line, mode);
}

std::string readToEnd(std::FILE* stream)
{
    std::string text;
    std::array<char, 4096> block{};
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        text.append(block.data(), length);
    return text;
}

std::FILE* streamOf(std::string const& text)
{
    Descriptor file(memfd_create("output of a command", MFD_CLOEXEC));
    std::FILE* const stream = file ? fdopen(file.get(), "w+e") : nullptr;
    if (!stream)
        return nullptr;
    file.release();
    std::fwrite(text.data(), 1, text.size(), stream);
    std::rewind(stream);
    return stream;
}

std::FILE* record(char const* line, std::FILE* running)
{
    std::string const output = readToEnd(running);
    // cppcheck-suppress AssignmentAddressToInteger ; it takes the call for the function
    int const status = state().runner.close(running);
    state().recorded.push_back({line, output});
    std::FILE* const stream = streamOf(output);
    if (stream)
        state().finished[stream] = status;
    return stream;
}

} // namespace

void setRunner(Runner const& runner)
{
    state().runner = runner;
}

void setListener(Listener* listener)
{
    state().listener = listener;
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

std::vector<RunCommand> const& Recording::commands() const
{
    return state().recorded;
}

std::string takeStandardError()
{
    int const file = standardErrorFile();
    std::string text;
    std::array<char, 4096> block{};
    off_t at = 0;
    for (ssize_t length = 0; (length = pread(file, block.data(), block.size(), at)) > 0;) {
        text.append(block.data(), static_cast<std::size_t>(length));
        at += length;
    }
    if (ftruncate(file, 0) != 0)
        text.clear();
    lseek(file, 0, SEEK_SET);
    return text;
}

std::string outputOf(std::string const& line)
{
    std::FILE* const running = start(line.c_str(), "r");
    if (!running)
        return "";
    std::string output = readToEnd(running);
    state().runner.close(running);
    return output;
}

std::FILE* open(char const* line, char const* mode)
{
    State& tapped = state();
    ++tapped.count;
    if (tapped.listener)
        tapped.listener->commandStarts(line);
    std::FILE* const running = start(line, mode);
    // A stream that the plug-in closed as an ordinary file may come back as another one.
    tapped.finished.erase(running);
    return running && tapped.recording ? record(line, running) : running;
}

int close(std::FILE* stream)
{
    auto const found = state().finished.find(stream);
    if (found == state().finished.end())
        // cppcheck-suppress CastAddressToIntegerAtReturn ; as above
        return state().runner.close(stream);
    int const status = found->second;
    state().finished.erase(found);
    std::fclose(stream);
    return status;
}

} // namespace mihost::commandTap
