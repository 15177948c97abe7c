#include "tests/fuzz/support/System.h"
#include "util/MyProcess.h"

#include <algorithm>
#include <cstring>

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    int fields[8] = {};
    std::size_t const used = std::min(size, sizeof fields);
    std::memcpy(fields, data, used);
    std::string month = fuzz::text(data + used, size - used);
    auto const [year, number, day, weekday, hour, minute, second, isdst] = fields;
    time_t const named =
        NQ::to_time_t(year, month.data(), day, weekday, hour, minute, second, isdst);
    time_t const numbered = NQ::ito_time_t(year, number, day, weekday, hour, minute, second, isdst);
    fuzz::require(year > 1900 || (named == 0 && numbered == 0));
    return 0;
}
