// Carries out a method call, such as "LocalGroupAdd,GroupName:CMPI_string:builders", as root.
// A refused call returns no reason, so this host collects it from the log.

#include "host/VXLogger.h"
#include "load_plugin.h"
#include "mihost/runtime/Runtime.h"

#include <iostream>

class Reasons : public mihost::LogSink
{
public:
    void write(mihost::LogMessage const& message) override
    {
        bool const output = message.text.rfind("outputBuffer: ", 0) == 0;
        bool const once = message.operation == mihost::LogMessage::Operation::Log;
        if (once && (output || message.level == VXLog::level::error))
            lines.push_back(message.text);
    }

    std::vector<std::string> lines;
};

int main(int argc, char** argv)
{
    if (argc != 3) {
        std::cerr << "usage: method_call PLUGIN CALL\n";
        return 2;
    }
    LoadedPlugin plugin(argv[1]);
    plugin.start();
    IC::MutableNode& os = *plugin.nodes(IC::nodeType::operatingSystem).front();

    Reasons reasons;
    mihost::setLogSink(&reasons);
    IC::Error const error =
        os.setProperty(IC::property::createUser, IC::PropertyValue(argv[2], true));
    mihost::setLogSink(nullptr);
    if (error.getStatus() == 0)
        return 0;
    std::cerr << "refused with status " << int{error.getStatus()} << '\n';
    for (std::string const& line : reasons.lines)
        std::cerr << line << '\n';
    return 1;
}
