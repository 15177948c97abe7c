#ifndef TESTS_FUZZ_SUPPORT_SYSTEM_H
#define TESTS_FUZZ_SUPPORT_SYSTEM_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace fuzz
{

/**
 * The machine as the plug-in sees it: while the object exists, only these files exist below /etc
 * and /var/log, and only these commands. The destructor closes the streams that the plug-in left
 * open.
 */
class System
{
public:
    System();
    ~System();
    System(System const&) = delete;
    System& operator=(System const&) = delete;

    /** By path. */
    std::map<std::string, std::string> files;

    /** Output by the beginning of the command line, the first that fits; others do not start. */
    std::vector<std::pair<std::string, std::string>> commands;

private:
    FILE* openFile(std::string const& path) const;
    FILE* start(std::string const& command) const;
};

std::string text(std::uint8_t const* data, std::size_t size);

/** @return as many texts as requested: the input split at lines "%%", the others empty */
std::vector<std::string> sections(std::uint8_t const* data, std::size_t size, std::size_t count);

/** Aborts the program, and so the run, if the condition is false. */
void require(bool holds);

} // namespace fuzz

#endif
