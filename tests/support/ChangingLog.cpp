#include "tests/support/ChangingLog.h"

#include <algorithm>
#include <cstdint>
#include <fcntl.h>
#include <filesystem>
#include <sys/mman.h>
#include <unistd.h>

namespace fs = std::filesystem;

std::string ChangingLog::line()
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

std::string ChangingLog::text()
{
    std::string text;
    for (unsigned long lines = choose(40); lines > 0; --lines)
        text += line() + '\n';
    return choose(4) == 0 ? text + line() : text;
}

/** Near the beginning, so that it is among the bytes that are compared. */
void ChangingLog::overwriteMapped()
{
    auto const size =
        static_cast<std::size_t>(std::min<std::uintmax_t>(fs::file_size(path()), 16384));
    if (size == 0)
        return;
    int const file = open(path().c_str(), O_RDWR | O_CLOEXEC);
    void* const pages = mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_SHARED, file, 0);
    char* const bytes = static_cast<char*>(pages);
    for (int times = 0; times < 3; ++times) {
        char& byte = bytes[choose(size)];
        byte = byte == '\n' ? 'n' : '\n';
    }
    munmap(pages, size);
    close(file);
}

void ChangingLog::change()
{
    folder_.append("log", ""); // from now on it exists
    auto const size = static_cast<std::size_t>(fs::file_size(path()));
    switch (choose(12)) {
    case 0:
        folder_.write("log", text());
        break;
    case 1: // rotated
        fs::rename(path(), folder_.path("log.1"));
        folder_.write("log", text());
        break;
    case 2: // replaced by another file, as editors do
        folder_.write("new", text());
        fs::rename(folder_.path("new"), path());
        break;
    case 3:
        fs::resize_file(path(), size / 2);
        break;
    case 4: { // the same size with other content
        std::string other = text();
        other.resize(size, '\n');
        folder_.write("log", other);
        break;
    }
    case 5:
        fs::resize_file(path(),
                        choose(4) == 0 ? size + choose(5000) : 0); // with NUL bytes, or empty
        break;
    case 6:
    case 7:
        overwriteMapped();
        break;
    default:
        folder_.append("log", text());
    }
}
