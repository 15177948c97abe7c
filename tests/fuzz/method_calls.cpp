#include "mihost/runtime/Runtime.h"
#include "sysdata/osInfo_linux.h"
#include "tests/fuzz/support/System.h"

namespace
{

constexpr char const* secret = "s3cr3tMark";

/** Checks that no message contains the password. */
class Log : public mihost::LogSink
{
public:
    Log()
    {
        mihost::setLogSink(this);
    }

    ~Log() override
    {
        mihost::setLogSink(nullptr);
    }

    void write(mihost::LogMessage const& message) override
    {
        fuzz::require(message.text.find(secret) == std::string::npos);
    }
};

void parse(std::string const& call)
{
    std::string method;
    std::vector<NQ::ParamInfo> params;
    int const status = NQ::OsInfo().parseMethodAndParams(call, method, params);
    fuzz::require(status == 0 || status == 1);
    fuzz::require(call.find(method) != std::string::npos);
    for (NQ::ParamInfo const& param : params) {
        fuzz::require(!param.name.empty() && param.type.rfind("CMPI_", 0) == 0);
        for (std::string const& text : {param.name, param.value})
            fuzz::require(text.find_first_of(",:") == std::string::npos);
    }
}

} // namespace

// A method call, what follows the password in another, and what the tools print.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    fuzz::System system;
    std::vector<std::string> const texts = fuzz::sections(data, size, 3);
    system.files = {{"/etc/redhat-release", ""}};
    system.commands = {{"", texts[2]}};
    parse(texts[0]);
    NQ::OsInfo().setCreateUser(texts[0]);

    if (fuzz::text(data, size).find(secret) != std::string::npos)
        return 0; // the fuzzer can produce such a coincidence
    // Without an item before it, the password's would be the method, whose name is logged.
    bool const hasMethod = texts[0].find_first_not_of(',') != std::string::npos;
    std::string const call = hasMethod ? texts[0] : "UserSetPassword";
    Log const log;
    NQ::OsInfo().setCreateUser(call + ",Password:CMPI_string:" + secret + texts[1]);
    return 0;
}
