#include "mihost/cli/plugin/CommandGuard.h"

#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/system/Stderr.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr std::string_view suseVersionLine =
    "echo $(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 9)."
    "$(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 12) | tr -d [:space:]";

/** Command lines of the plug-in that use the shell's syntax and contain no text from outside. */
constexpr std::string_view fixedLines[] = {
    "chpasswd -e < usrandpwd ; rm -f usrandpwd",
    "stat /etc/SuSE-release | grep Change",
    "stat /etc/UnitedLinux-release | grep Change",
    "stat /etc/redhat-release | grep Change",
    " cat /etc/vmware-release  | tr -d '[:alpha:][:space:][()]'",
    "cat /etc/redhat-release  | tr -d '[:alpha:][:space:][()]'",
    suseVersionLine,
};

/** What the plug-in adds to the arguments, longer ones first. */
constexpr std::string_view suffixes[] = {" 2>&1;echo rc=$? 2>&1", " 2>&1"};

bool takeStart(std::string_view& text, std::string_view start)
{
    bool const begins = text.substr(0, start.size()) == start;
    if (begins)
        text.remove_prefix(start.size());
    return begins;
}

bool takeEnd(std::string_view& text, std::string_view end)
{
    bool const ends = text.size() >= end.size() && text.substr(text.size() - end.size()) == end;
    if (ends)
        text.remove_suffix(end.size());
    return ends;
}

bool isControl(char byte)
{
    auto const value = static_cast<unsigned char>(byte);
    return value < 0x20 || value == 0x7F;
}

/** Words separated by blanks; metacharacters are escaped, blanks may be in double quotes. */
std::optional<std::string> objectionToWords(std::string_view text)
{
    bool inQuotes = false;
    for (std::size_t at = 0; at < text.size(); ++at) {
        char const byte = text[at];
        if (isControl(byte))
            return "it contains a control character";
        bool const escapes = byte == '\\' && at + 1 < text.size() && !isControl(text[at + 1]);
        if (escapes)
            ++at;
        else if (byte == '"')
            inQuotes = !inQuotes;
        else if (shellMetacharacters.find(byte) != std::string_view::npos)
            return fmt::format("it contains the shell metacharacter '{}'", byte);
    }
    return inQuotes ? std::optional("its quotes do not end") : std::nullopt;
}

std::optional<std::string> objectionToModule(std::string_view name)
{
    auto const reason = objection(Form::AccountName, name); // of the same form
    if (!reason)
        return std::nullopt;
    return fmt::format("the name of the module '{}' {}", printable(name), *reason);
}

/** @param text  after "echo ": a password and the command that reads it from a pipe */
std::optional<std::string> objectionToPasswordPipe(std::string_view text)
{
    constexpr std::string_view reader = " | /usr/bin/passwd ";
    std::size_t const pipe = text.find(reader);
    if (pipe == std::string_view::npos)
        return objectionToWords(text);
    auto const reason = objectionToWords(text.substr(0, pipe));
    return reason ? reason : objectionToWords(text.substr(pipe + reader.size()));
}

} // namespace

std::optional<std::string> objectionToCommand(std::string_view line)
{
    if (std::find(std::begin(fixedLines), std::end(fixedLines), line) != std::end(fixedLines))
        return std::nullopt;
    if (takeStart(line, "modinfo "))
        return objectionToModule(line);
    if (takeStart(line, "sed -n '") && takeEnd(line, "p' /var/log/messages"))
        return objectionToWords(line);
    for (std::string_view const suffix : suffixes)
        if (takeEnd(line, suffix))
            break;
    if (takeStart(line, "echo "))
        return objectionToPasswordPipe(line);
    return objectionToWords(line);
}

bool mayRun(char const* line)
{
    auto const reason = objectionToCommand(line);
    if (!reason)
        return true;
    std::string_view const text = line;
    warn(fmt::format("command not run: {}: {}", text.substr(0, text.find(' ')), *reason));
    return false;
}

} // namespace mihost
