// accounts_host TIMES: starts the plug-in, refreshes its users and groups TIMES times, and
// prints in milliseconds what the start spent on users and groups and what each refresh took.

#include "bench/support/Timed.h"
#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "tests/support/Plugin.h"

#include <cstdio>
#include <cstdlib>

namespace
{

Plugin& plugin()
{
    static Plugin loaded;
    return loaded;
}

double spent = 0;

/** Calls the plug-in's own operation of that name and adds up how long it takes. */
void timedCall(IC::OsSwMI* self, char const* name, bool refresh)
{
    using Operation = void (*)(IC::OsSwMI*, bool);
    auto const own = reinterpret_cast<Operation>(plugin().symbol(name));
    double const before = millisecondsNow();
    own(self, refresh);
    spent += millisecondsNow() - before;
}

} // namespace

// The loader binds the plug-in's calls to these.
void IC::OsSwMI::createUserNodes(bool refresh)
{
    timedCall(this, "_ZN2IC6OsSwMI15createUserNodesEb", refresh);
}

void IC::OsSwMI::createGroupNodes(bool refresh)
{
    timedCall(this, "_ZN2IC6OsSwMI16createGroupNodesEb", refresh);
}

int main(int argc, char* argv[])
{
    if (argc != 2)
        return EXIT_FAILURE;
    plugin().initialize();
    std::printf("%.4f\n", spent);
    IC::MutableNode& os = plugin().node(IC::nodeType::operatingSystem);
    for (int left = std::atoi(argv[1]); left > 0; --left) {
        double const before = millisecondsNow();
        os.setProperty(IC::property::refresh,
                       IC::PropertyValue(IC::Number(IC::command::rebuild), true));
        std::printf("%.4f\n", millisecondsNow() - before);
    }
    return EXIT_SUCCESS;
}
