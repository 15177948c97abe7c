#include "mihost/cli/doctor/FileChecks.h"

#include "mihost/cli/accounts/LoginDefs.h"
#include "mihost/cli/log/LogLine.h"
#include "mihost/cli/system/TextFile.h"
#include "mihost/sandbox/OwnedStream.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <grp.h>
#include <memory>
#include <pwd.h>
#include <shadow.h>

namespace mihost
{

namespace
{

constexpr std::size_t entryBuffer = 4096; // what the plug-in reads an account's entries into

/** Reads one line as libc reads a file of such entries. */
template <class Entry> class LineEntry
{
public:
    using Read = int (*)(std::FILE*, Entry*, char*, std::size_t, Entry**);

    LineEntry(std::string line, Read read, std::size_t size) : line_(std::move(line)), buffer_(size)
    {
        line_ += '\n';
        Stream const file(fmemopen(line_.data(), line_.size(), "r"));
        Entry* found = nullptr;
        error_ = read(file.get(), &entry_, buffer_.data(), buffer_.size(), &found);
    }

    Entry const* entry() const
    {
        return error_ == 0 ? &entry_ : nullptr;
    }

    bool isTooLong() const
    {
        return error_ == ERANGE;
    }

private:
    std::string line_;
    std::vector<char> buffer_;
    Entry entry_{};
    int error_ = 0;
};

bool isPassedOver(std::string const& line)
{
    std::size_t const start = line.find_first_not_of(" \t");
    return start == std::string::npos || line[start] == '#';
}

/** @param growth  bytes that the buffer has for each of a line's, beyond the plug-in's */
template <class Entry>
Problem problemOfEntries(std::string const& text, typename LineEntry<Entry>::Read read,
                         std::size_t growth)
{
    auto const lines = linesOf(text);
    for (std::size_t at = 0; at < lines.size(); ++at) {
        if (isPassedOver(lines[at]))
            continue;
        LineEntry<Entry> const parsed(lines[at], read, entryBuffer + growth * lines[at].size());
        if (!parsed.entry())
            return fmt::format("line {} is {}", at + 1,
                               parsed.isTooLong() ? "too long" : "malformed");
    }
    return std::nullopt;
}

/** The names in shadow entries, up to one that ends the plug-in's reading. */
std::vector<std::string> shadowNames(std::string const& text)
{
    std::vector<std::string> names;
    for (std::string const& line : linesOf(text)) {
        LineEntry<spwd> const parsed(line, fgetspent_r, entryBuffer);
        if (parsed.isTooLong())
            break;
        if (parsed.entry())
            names.emplace_back(parsed.entry()->sp_namp);
    }
    return names;
}

} // namespace

Problem problemOfRanges(std::string const& text)
{
    std::vector<std::string> const missing = LoginDefs(text).missingKeys();
    if (missing.empty())
        return std::nullopt;
    return fmt::format("no line begins with {} and a number", fmt::join(missing, ", "));
}

Problem problemOfAccounts(std::string const& text)
{
    return problemOfEntries<passwd>(text, fgetpwent_r, 0);
}

Problem problemOfGroups(std::string const& text)
{
    constexpr std::size_t growth = 16; // a pointer for each member, and groups have no limit
    return problemOfEntries<group>(text, fgetgrent_r, growth);
}

Problem problemOfShadow(std::vector<std::string> const& accounts, std::string const& text)
{
    std::vector<std::string> const shadow = shadowNames(text);
    auto entry = shadow.begin();
    for (std::string const& account : accounts) {
        auto const found = std::find(entry, shadow.end(), account);
        if (found == shadow.end())
            return fmt::format("no entry for '{}' at its place in the order of /etc/passwd",
                               account);
        entry = found + 1;
    }
    return std::nullopt;
}

Problem problemOfRelease(std::string const& text)
{
    constexpr std::size_t shortestMajor = 10;
    constexpr std::size_t shortestMinor = 13;
    auto const lines = linesOf(text);
    if (lines.size() >= 3 && lines[1].size() >= shortestMajor && lines[2].size() >= shortestMinor)
        return std::nullopt;
    return "no lines like 'VERSION = 1' and 'PATCHLEVEL = 0' after the first";
}

Problem problemOfStamps(std::vector<std::string> const& lines)
{
    auto const other = std::find_if(lines.rbegin(), lines.rend(),
                                    [](std::string const& line) { return !hasStamp(line); });
    if (other == lines.rend())
        return std::nullopt;
    return fmt::format("a line begins with '{}' instead of a time stamp like 'Jan  2 03:04:05 '",
                       other->substr(0, 16));
}

} // namespace mihost
