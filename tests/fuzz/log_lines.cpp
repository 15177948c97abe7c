#include "sysdata/logInfo_linux.h"
#include "tests/fuzz/support/System.h"

// Output of wc, of sed and of date.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::vector<std::string> const outputs = fuzz::sections(data, size, 3);
    system.commands = {{"wc ", outputs[0]}, {"sed ", outputs[1]}, {"date", outputs[2]}};
    NQ::logInfo log;
    for (unsigned int const index : {0U, 1U, 50U}) {
        std::string message;
        long time = 0;
        if (log.getData(message, index))
            fuzz::require(message.size() >= 2 && message.front() == '*' && message.back() == '*');
        log.getCreationTime(time, index);
    }
    return 0;
}
