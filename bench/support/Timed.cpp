#include "bench/support/Timed.h"

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Program.h"

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <stdexcept>
#include <sys/resource.h>

namespace
{

double childrensTime()
{
    rusage used{};
    getrusage(RUSAGE_CHILDREN, &used);
    return 1e3 * static_cast<double>(used.ru_utime.tv_sec + used.ru_stime.tv_sec) +
           1e-3 * static_cast<double>(used.ru_utime.tv_usec + used.ru_stime.tv_usec);
}

} // namespace

double millisecondsNow()
{
    std::chrono::duration<double, std::milli> const time =
        std::chrono::steady_clock::now().time_since_epoch();
    return time.count();
}

Timed timed(std::vector<std::string> const& arguments)
{
    double const wholeBefore = millisecondsNow();
    double const cpuBefore = childrensTime();
    Outcome const outcome = runToEnd(arguments);
    double const whole = millisecondsNow() - wholeBefore;
    if (outcome.code != 0)
        throw std::runtime_error(arguments.back() + " failed with " + std::to_string(outcome.code) +
                                 ": " + outcome.err);
    return {whole, childrensTime() - cpuBefore, outcome.out};
}

void enterCopy()
{
    if (auto const reason = mihost::enterSandbox())
        throw std::runtime_error("cannot copy this machine: " + *reason);
    setenv("PATH", "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin", 1);
    setenv("LC_ALL", "C", 1);
}

int runBench(int argc, char* argv[], void (*measure)(bool quick))
try {
    measure(argc > 1 && std::strcmp(argv[1], "--quick") == 0);
    return EXIT_SUCCESS;
} catch (std::exception const& problem) {
    std::fprintf(stderr, "%s: %s\n", argv[0], problem.what());
    return EXIT_FAILURE;
}
