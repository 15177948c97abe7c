#include "sysdata/osInfo_linux.h"
#include "tests/fuzz/support/System.h"
#include "util/MyProcess.h"

#include <cstring>

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    std::string const text = fuzz::text(data, size);
    char const first = text.empty() ? ' ' : text[0];
    char const last = text.empty() ? ' ' : text.back();

    std::string line = text;
    char const* const value = NQ::strget(line.data(), first);
    fuzz::require(std::strchr(value, '\n') == nullptr);

    line = text;
    NQ::OsInfo().strreplace(line.data(), last, '-');
    fuzz::require(line.size() == size && (line.empty() || line[0] == first));

    line = text;
    NQ::OsInfo().trimString(line);
    fuzz::require(text.find(line) != std::string::npos);

    std::vector<std::string> tokens;
    NQ::Tokenize(text, tokens, std::string(1, first));
    for (std::string const& token : tokens)
        fuzz::require(!token.empty() && token.find(first) == std::string::npos);
    return 0;
}
