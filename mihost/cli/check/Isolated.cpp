#include "mihost/cli/check/Isolated.h"

#include "mihost/cli/check/Subject.h"
#include "mihost/cli/output/Json.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/Pipe.h"

#include <algorithm>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <poll.h>
#include <sys/mman.h>
#include <sys/prctl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <system_error>
#include <utility>

namespace mihost::checks
{

namespace
{

using Clock = std::chrono::steady_clock;

constexpr std::size_t mostFindings = 5; // shown of one check

// The keys of the lines that the scenario's process writes, one for each check.
constexpr char findingsKey[] = "findings";
constexpr char notesKey[] = "notes";
constexpr char skippedKey[] = "skipped";
constexpr char notLoadedKey[] = "not-loaded";
constexpr char lastKey[] = "last"; // the plug-in's state is unusable

// --- In the scenario's process

Json bounded(Findings const& findings)
{
    Json list = Json::array();
    for (std::size_t at = 0; at < std::min(findings.size(), mostFindings); ++at)
        list.push_back(validUtf8(findings[at]));
    if (findings.size() > mostFindings)
        list.push_back(fmt::format("and {} more", findings.size() - mostFindings));
    return list;
}

Json lineOf(Verdict const& verdict, bool last = false)
{
    return {{findingsKey, bounded(verdict.findings)},
            {notesKey, bounded(verdict.notes)},
            {skippedKey, verdict.skipped ? Json(*verdict.skipped) : Json(nullptr)},
            {lastKey, last}};
}

Json lineOfException(std::string const& what)
{
    return lineOf({{what}}, true);
}

Json carryOut(Check const& check, Subject& subject)
{
    try {
        return lineOf(check.run(subject));
    } catch (Failure const& failure) {
        if (failure.code() == NoPlugin)
            return {{notLoadedKey, validUtf8(failure.what())}};
        return lineOfException(failure.what());
    } catch (std::exception const& exception) {
        return lineOfException(fmt::format("exception: {}", exception.what()));
    } catch (...) {
        return lineOfException("exception of an unknown type");
    }
}

void writeLine(Descriptor const& to, Json const& line)
{
    std::string const text = line.dump() + '\n';
    for (std::size_t written = 0; written < text.size();) {
        ssize_t const count = write(to.get(), text.data() + written, text.size() - written);
        if (count < 0 && errno != EINTR)
            _exit(EXIT_FAILURE); // the program is gone
        written += static_cast<std::size_t>(std::max<ssize_t>(count, 0));
    }
}

/** @param complaints  where standard error goes */
[[noreturn]] void runInChild(Scenario const& scenario, Settings const& settings,
                             Descriptor const& report, Descriptor const& complaints)
{
    setpgid(0, 0); // what it leaves running is found by its group
    prctl(PR_SET_PDEATHSIG, SIGKILL);
    Descriptor const nothing(open("/dev/null", O_RDWR | O_CLOEXEC));
    dup2(nothing.get(), STDIN_FILENO);
    dup2(nothing.get(), STDOUT_FILENO);
    dup2(complaints.get(), STDERR_FILENO);
    for (int const signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
        std::signal(signal, SIG_DFL);
    Subject subject(settings.file, settings.rounds);
    for (Check const& check : scenario.checks)
        writeLine(report, carryOut(check, subject));
    _exit(EXIT_SUCCESS);
}

// --- In the program's process

/** The process that a scenario runs in; nothing of it is left at the end. */
class Child
{
public:
    explicit Child(pid_t id) : id_(id), handle_(openHandle(id)) {}
    ~Child()
    {
        if (id_ > 0)
            end();
    }
    Child(Child const&) = delete;
    Child& operator=(Child const&) = delete;

    /** Readable once the process has ended. */
    int handle() const
    {
        return handle_.get();
    }

    /** Kills what still runs of it. @return its wait status */
    int end()
    {
        int status = 0;
        kill(-id_, SIGKILL);
        kill(id_, SIGKILL); // if it was not yet in its own group
        while (waitpid(id_, &status, 0) < 0 && errno == EINTR) {
        }
        id_ = -1;
        return status;
    }

private:
    /** @throws std::system_error if the process cannot be watched; it is killed then */
    static Descriptor openHandle(pid_t id)
    {
        // By its number: glibc 2.36 declares the function for C only.
        auto const handle = static_cast<int>(syscall(SYS_pidfd_open, id, 0));
        if (handle < 0) {
            int const problem = errno;
            kill(id, SIGKILL);
            waitpid(id, nullptr, 0);
            errno = problem;
            failed("cannot watch a process");
        }
        return Descriptor(handle);
    }

    pid_t id_;
    Descriptor handle_;
};

enum class Ending { Itself, TimeLimit };

/** Appends the available bytes. @return whether more may follow */
bool readSome(Descriptor const& from, std::string& text)
{
    char block[4096];
    ssize_t const count = read(from.get(), block, sizeof block);
    if (count > 0)
        text.append(block, static_cast<std::size_t>(count));
    return count > 0 || (count < 0 && errno == EINTR);
}

/** Reads until the process has ended; something that it left running may hold the pipe. */
Ending readReport(Descriptor const& from, Child const& child, std::chrono::seconds limit,
                  std::string& text)
{
    auto const deadline = Clock::now() + limit;
    fcntl(from.get(), F_SETFL, O_NONBLOCK);
    for (;;) {
        auto const left =
            std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
        if (left.count() <= 0)
            return Ending::TimeLimit;
        pollfd watched[] = {{from.get(), POLLIN, 0}, {child.handle(), POLLIN, 0}};
        if (poll(watched, std::size(watched), static_cast<int>(left.count())) < 0)
            continue;
        bool const ended = watched[1].revents != 0;
        if (watched[0].revents != 0 || ended)
            while (readSome(from, text)) {
            }
        if (ended)
            return Ending::Itself;
        if ((watched[0].revents & POLLIN) == 0 && watched[0].revents != 0)
            poll(&watched[1], 1, static_cast<int>(left.count())); // closed: only the end is left
    }
}

std::string lastLine(std::string text)
{
    text.erase(text.find_last_not_of('\n') + 1);
    return text.substr(text.rfind('\n') + 1);
}

/** The last line that the process wrote to standard error. */
std::string lastWords(Descriptor const& complaints)
{
    constexpr off_t enough = 4096;
    struct stat status {
    };
    if (fstat(complaints.get(), &status) != 0)
        return "";
    off_t const from = std::max<off_t>(0, status.st_size - enough);
    std::string text(static_cast<std::size_t>(status.st_size - from), '\0');
    ssize_t const count = pread(complaints.get(), text.data(), text.size(), from);
    text.resize(static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
    return validUtf8(lastLine(std::move(text)));
}

std::string endText(Ending ending, int status, Settings const& settings, std::string const& words)
{
    std::string text;
    if (ending == Ending::TimeLimit)
        text = fmt::format("not done after {} s", settings.timeLimit.count());
    else if (WIFSIGNALED(status))
        text = fmt::format("killed by SIG{}", sigabbrev_np(WTERMSIG(status)));
    else
        text = fmt::format("ended the process with the exit code {}", WEXITSTATUS(status));
    return words.empty() ? text : fmt::format("{}: {}", text, words);
}

std::vector<std::string> textsOf(Json const& list)
{
    return list.get<std::vector<std::string>>();
}

/** The lines that the process wrote, one after the other. */
class ReportLines
{
public:
    explicit ReportLines(std::string const& text) : text_(text) {}

    /** @return null after the last whole line */
    Json next()
    {
        std::size_t const end = text_.find('\n', from_);
        if (end == std::string::npos)
            return nullptr;
        std::string const line = text_.substr(from_, end - from_);
        from_ = end + 1;
        return Json::parse(line);
    }

private:
    std::string const& text_;
    std::size_t from_ = 0;
};

/** @throws Failure if the line says that the plug-in cannot be loaded */
Verdict verdictOf(Json const& document)
{
    if (document.contains(notLoadedKey))
        throw Failure(NoPlugin, document[notLoadedKey]);
    Verdict verdict{textsOf(document[findingsKey]), textsOf(document[notesKey])};
    if (document[skippedKey].is_string())
        verdict.skipped = document[skippedKey].get<std::string>();
    return verdict;
}

/** The verdicts reported, then a finding for the check that ended it all, then skipped ones. */
std::vector<Result> resultsOf(Scenario const& scenario, std::string const& text,
                              std::string const& end)
{
    ReportLines lines(text);
    std::vector<Result> results;
    std::string stoppedBy;
    for (Check const& check : scenario.checks) {
        Result result{fmt::format("{}.{}", scenario.name, check.name), check.meaning, {}};
        if (!stoppedBy.empty()) {
            result.verdict.skipped = fmt::format("not reached after {}", stoppedBy);
        } else if (Json const line = lines.next(); !line.is_null()) {
            result.verdict = verdictOf(line);
            if (line[lastKey])
                stoppedBy = result.name;
        } else {
            result.verdict.findings.push_back(end);
            stoppedBy = result.name;
        }
        results.push_back(result);
    }
    return results;
}

} // namespace

std::vector<Result> runIsolated(Scenario const& scenario, Settings const& settings)
{
    try {
        Pipe report;
        Descriptor const complaints(mihost::check(memfd_create("complaints", MFD_CLOEXEC),
                                                  "cannot create a temporary file"));
        std::fflush(nullptr); // or both processes would write the buffered output
        pid_t const id = mihost::check(fork(), "cannot start a process");
        if (id == 0)
            runInChild(scenario, settings, report.writeEnd, complaints);
        Child child(id);
        report.writeEnd.reset();
        std::string text;
        Ending const ending = readReport(report.readEnd, child, settings.timeLimit, text);
        int const status = child.end();
        return resultsOf(scenario, text, endText(ending, status, settings, lastWords(complaints)));
    } catch (std::system_error const& error) {
        throw Failure(BadUsage, fmt::format("cannot check the plug-in: {}", error.what()));
    }
}

} // namespace mihost::checks
