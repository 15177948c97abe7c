#include "tests/support/OneByOne.h"

#include "mihost/sandbox/Descriptor.h"

#include <algorithm>
#include <cstdlib>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <iostream>
#include <random>
#include <sstream>
#include <stdexcept>
#include <string>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace
{

using Names = std::vector<std::string>;

constexpr int skipped = 77; // exit status

struct Ended {
    int status; // as from waitpid
    std::string output;
};

std::string readToEnd(int file)
{
    std::string text;
    char buffer[4096];
    for (ssize_t got = 0; (got = read(file, buffer, sizeof buffer)) > 0;)
        text.append(buffer, static_cast<std::size_t>(got));
    return text;
}

Ended runInChild(std::function<int()> const& run)
{
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0)
        throw std::runtime_error("no pipe");
    mihost::Descriptor const reading(ends[0]);
    mihost::Descriptor writing(ends[1]);
    std::cout.flush();
    std::fflush(nullptr);
    pid_t const child = fork();
    if (child < 0)
        throw std::runtime_error("no process");
    if (child == 0) {
        dup2(writing.get(), STDOUT_FILENO);
        dup2(writing.get(), STDERR_FILENO);
        std::exit(run());
    }
    writing.reset();
    std::string const output = readToEnd(reading.get());
    int status = 0;
    waitpid(child, &status, 0);
    return {status, output};
}

Names selected()
{
    std::istringstream list(runInChild([] {
                                GTEST_FLAG_SET(list_tests, true);
                                return RUN_ALL_TESTS();
                            }).output);
    Names names;
    std::string suite;
    for (std::string line; std::getline(list, line);) {
        std::string const name = line.substr(0, line.find("  # "));
        if (name.rfind("  ", 0) == 0)
            names.push_back(suite + name.substr(2));
        else
            suite = name;
    }
    return names;
}

int numberIn(char const* variable, int otherwise)
{
    char const* const text = std::getenv(variable);
    return text ? std::atoi(text) : otherwise;
}

Names ofThisShard(Names const& all)
{
    auto const shards = static_cast<std::size_t>(std::max(numberIn("GTEST_TOTAL_SHARDS", 1), 1));
    auto const shard = static_cast<std::size_t>(numberIn("GTEST_SHARD_INDEX", 0));
    Names own;
    for (std::size_t at = shard; at < all.size(); at += shards)
        own.push_back(all[at]);
    return own;
}

Ended runOne(std::string const& name, std::function<int()> const& runTests)
{
    return runInChild([&] {
        unsetenv("GTEST_TOTAL_SHARDS");
        unsetenv("GTEST_SHARD_INDEX");
        GTEST_FLAG_SET(filter, name);
        GTEST_FLAG_SET(repeat, 1);
        int const status = runTests();
        bool const wasSkipped = testing::UnitTest::GetInstance()->skipped_test_count() > 0;
        return status == EXIT_SUCCESS && wasSkipped ? skipped : status;
    });
}

/** @return those that failed */
Names runAll(Names const& names, std::function<int()> const& runTests)
{
    Names failed;
    for (std::string const& name : names) {
        Ended const ended = runOne(name, runTests);
        bool const isSkipped = WIFEXITED(ended.status) && WEXITSTATUS(ended.status) == skipped;
        bool const hasPassed = WIFEXITED(ended.status) && WEXITSTATUS(ended.status) == EXIT_SUCCESS;
        if (!hasPassed)
            std::cout << ended.output;
        if (!hasPassed && !isSkipped)
            failed.push_back(name);
        char const* const result = hasPassed   ? "[       OK ] "
                                   : isSkipped ? "[  SKIPPED ] "
                                               : "[  FAILED  ] ";
        std::cout << result << name << '\n';
    }
    return failed;
}

} // namespace

int runTestsOneByOne(std::function<int()> const& runTests)
{
    if (GTEST_FLAG_GET(list_tests))
        return RUN_ALL_TESTS();
    Names names = ofThisShard(selected());
    if (names.size() == 1)
        return runTests();
    std::mt19937 random(static_cast<unsigned int>(GTEST_FLAG_GET(random_seed)));
    Names failed;
    int const rounds = GTEST_FLAG_GET(repeat);
    for (int round = 0; round < rounds && failed.empty(); ++round) {
        if (GTEST_FLAG_GET(shuffle))
            std::shuffle(names.begin(), names.end(), random);
        failed = runAll(names, runTests);
        std::cout << "[==========] " << names.size()
                  << " tests ran, each in a process of its own.\n"
                  << "[  PASSED  ] " << names.size() - failed.size() << " tests.\n";
    }
    for (std::string const& name : failed)
        std::cout << "[  FAILED  ] " << name << '\n';
    return failed.empty() ? EXIT_SUCCESS : EXIT_FAILURE;
}
