#include "mihost/cli/plugin/Redaction.h"

#include <algorithm>
#include <string_view>

namespace mihost
{

namespace
{

bool endsWord(char character)
{
    return std::string_view(" \t\n'\"`:").find(character) != std::string_view::npos;
}

std::vector<std::string>& hidden()
{
    static std::vector<std::string> secrets;
    return secrets;
}

} // namespace

std::string withoutSecrets(std::string const& text, std::vector<std::string> const& secrets)
{
    if (secrets.empty())
        return text;
    std::string result;
    std::size_t start = 0;
    while (start <= text.size()) {
        std::size_t end = start;
        while (end < text.size() && !endsWord(text[end]))
            ++end;
        std::string const word = text.substr(start, end - start);
        bool const isSecret =
            !word.empty() && std::find(secrets.begin(), secrets.end(), word) != secrets.end();
        result += isSecret ? "(hidden)" : word;
        if (end < text.size())
            result += text[end];
        start = end + 1;
    }
    return result;
}

RedactingSink::Hiding::Hiding(std::vector<std::string> const& secrets)
{
    hidden() = secrets;
}

RedactingSink::Hiding::~Hiding()
{
    hidden().clear();
}

void RedactingSink::write(LogMessage const& message)
{
    if (hidden().empty()) {
        to_.write(message);
        return;
    }
    std::string const text = withoutSecrets(message.text, hidden());
    to_.write({message.operation, message.function, message.file, message.line, message.category,
               message.level, message.extra, message.first, message.second, text});
}

} // namespace mihost
