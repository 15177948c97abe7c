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
 * The machine as the plug-in sees it for as long as it lives: below /etc and /var/log only these
 * files exist, and only these commands. Streams that the plug-in leaves open are closed at the end.
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

/** The requested number of texts: the input cut at lines "%%", the rest empty. */
std::vector<std::string> sections(std::uint8_t const* data, std::size_t size, std::size_t count);

/** Ends the program, and so the run, where something that must hold does not. */
void require(bool holds);

} // namespace fuzz

#endif
