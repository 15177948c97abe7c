#include "host/PropertyValue.h"
#include "host/VXMessageBuffer.h"
#include "host/make_string.h"
#include "tests/fuzz/support/System.h"

#include <algorithm>
#include <cstring>

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    std::string const text = fuzz::text(data, size);
    fuzz::require(NQ::make_string(NQ::make_wstring(text)) == text);

    IC::PropertyValue const value(text, true);
    fuzz::require(static_cast<std::string>(value) == text);
    unsigned int const number = value;
    fuzz::require(number == 0 || text.find(std::to_string(number)) != std::string::npos);

    VXLog::VXMessageBuffer buffer;
    fuzz::require(buffer.str(buffer << text << number) == text + std::to_string(number));

    long seconds = 0;
    std::memcpy(&seconds, data, std::min(size, sizeof seconds));
    IC::PropertyValue const date(IC::Number(seconds, 0), true);
    fuzz::require(!static_cast<std::string>(date).empty());
    return 0;
}
