#ifndef TESTS_SUPPORT_COMPAREDLOG_H
#define TESTS_SUPPORT_COMPAREDLOG_H

#include "mihost/sandbox/Descriptor.h"
#include "tests/support/BothWays.h"
#include "tests/support/ScratchFolder.h"

#include <algorithm>
#include <cstdint>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <random>
#include <sys/mman.h>

/** A log in its own directory, which is changed in every way that logs are changed. */
class ChangingLog
{
public:
    explicit ChangingLog(unsigned int seed) : random_(seed) {}

    std::string path() const
    {
        return folder_.path("log");
    }

    /**
     * Appends to the log, truncates, rotates, replaces or overwrites it, with or without a change
     * of its times. Its lines are of every kind: empty, without an end, of 2 MB, with NUL bytes or
     * carriage returns.
     */
    void change()
    {
        folder_.append("log", ""); // from now on it exists
        auto const size = static_cast<std::size_t>(std::filesystem::file_size(path()));
        switch (choose(12)) {
        case 0:
            folder_.write("log", text());
            break;
        case 1: // rotated
            std::filesystem::rename(path(), folder_.path("log.1"));
            folder_.write("log", text());
            break;
        case 2: // replaced by another file, as editors do
            std::filesystem::rename(folder_.write("new", text()), path());
            break;
        case 3:
            std::filesystem::resize_file(path(), size / 2);
            break;
        case 4: { // the same size with other content
            std::string other = text();
            other.resize(size, '\n');
            folder_.write("log", other);
            break;
        }
        case 5: // with NUL bytes, or empty
            std::filesystem::resize_file(path(), choose(4) == 0 ? size + choose(5000) : 0);
            break;
        case 6:
        case 7:
            overwriteMapped(std::min<std::size_t>(size, 16384));
            break;
        default:
            folder_.append("log", text());
        }
    }

    /** @return a random number from 0 to limit - 1 */
    unsigned long choose(unsigned long limit)
    {
        return random_() % limit;
    }

private:
    std::string line()
    {
        constexpr std::size_t often = 120;
        constexpr std::size_t seldom = 70'000;
        constexpr std::size_t hardlyEver = 2'000'000;
        unsigned long const kind = choose(300);
        std::string line(choose(kind == 0 ? hardlyEver : kind < 15 ? seldom : often), ' ');
        bool const hasAnyByte = kind > 290;
        for (char& character : line)
            character = static_cast<char>(hasAnyByte ? choose(256) : 'a' + choose(26));
        std::replace(line.begin(), line.end(), '\n', hasAnyByte ? '\0' : ' ');
        return kind > 200 ? line + '\r' : line;
    }

    std::string text()
    {
        std::string text;
        for (unsigned long lines = choose(40); lines > 0; --lines)
            text += line() + '\n';
        return choose(4) == 0 ? text + line() : text;
    }

    /** Near the beginning, so that it is among the bytes that are compared. */
    void overwriteMapped(std::size_t size)
    {
        if (size == 0)
            return;
        mihost::Descriptor const file(open(path().c_str(), O_RDWR | O_CLOEXEC));
        void* const pages = mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_SHARED, file.get(), 0);
        for (int times = 0; times < 3; ++times) {
            char& byte = static_cast<char*>(pages)[choose(size)];
            byte = byte == '\n' ? 'n' : '\n';
        }
        munmap(pages, size);
    }

    ScratchFolder folder_;
    std::mt19937 random_;
};

inline std::string sedCommand(std::uint64_t line, std::string const& path)
{
    return "sed -n '" + std::to_string(line) + "p' " + path;
}

/**
 * Changes a log again and again and compares what wc and sed print with the accelerator's answers.
 * It may leave only sed to the real command, for lines with NUL bytes or without an end.
 *
 * @return the percentage of sed commands that were answered
 */
inline unsigned long percentOfSedsAnswered(unsigned int seed, int rounds)
{
    ChangingLog log(seed);
    unsigned long asked = 0;
    unsigned long ofThem = 0;
    for (int round = 0; round < rounds && !testing::Test::HasFailure(); ++round) {
        for (unsigned long changes = round == 0 ? 1 : log.choose(4); changes > 0; --changes)
            log.change();
        std::string const wc = "wc -l " + log.path();
        std::string together = bothways::answered(wc).value();
        std::string script = wc;
        std::uint64_t const last = std::stoull(together);
        for (std::uint64_t const line : {1 + log.choose(last + 2), last, last + 1}) {
            std::string const sed = sedCommand(std::max<std::uint64_t>(line, 1), log.path());
            ++asked;
            if (auto const text = bothways::answered(sed)) {
                ++ofThem;
                together += *text;
                script += "; " + sed;
            }
        }
        EXPECT_TRUE(together == bothways::real(script)) << round << ' ' << script;
    }
    return 100 * ofThem / asked;
}

#endif
