#include "bench/support/MadeUp.h"

#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"

#include <fstream>
#include <string>
#include <vector>

namespace madeUp
{

void accounts(int users)
{
    std::string passwd = "root:x:0:0:root:/root:/bin/bash\n";
    std::string shadow = "root:*:19000:0:99999:7:::\n";
    std::string group = "root:x:0:\n";
    std::string everyone = "everyone:x:50000:";
    for (int user = 0; user < users; ++user) {
        std::string const id = std::to_string(10000 + user);
        std::string const name = "user" + id;
        passwd +=
            name + ":x:" + id + ':' + id + ":User " + id + ",,,:/home/" + name + ":/bin/bash\n";
        shadow += name + ":$6$saltsalt$" + std::string(86, 'h') + ":19000:0:99999:7:::\n";
        group += name + ":x:" + id + ":\n";
        everyone += (user == 0 ? "" : ",") + name;
    }
    machine::write("/etc/login.defs", "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX 60000\n");
    machine::write("/etc/passwd", passwd);
    machine::write("/etc/shadow", shadow, 0640);
    machine::write("/etc/group", group + everyone + '\n');
}

void modules(int count)
{
    std::vector<kernelModules::Loaded> loaded;
    for (int i = 0; i < count; ++i) {
        std::string const name = "module_" + std::to_string(i);
        std::vector<std::string> facts{"description=Driver number " + std::to_string(i),
                                       "license=GPL",
                                       "version=1." + std::to_string(i),
                                       "author=Somebody <somebody@example.org>",
                                       "srcversion=0123456789ABCDEF01234567",
                                       "depends=",
                                       "retpoline=Y",
                                       "intree=Y",
                                       "name=" + name,
                                       "parm=debug:How much to say",
                                       "parmtype=debug:int"};
        for (int alias = 0; alias < 8; ++alias)
            facts.push_back("alias=pci:v00008086d0000" + std::to_string(1000 + alias) +
                            "sv*sd*bc*sc*i*");
        kernelModules::write("kernel/drivers/" + name + ".ko", kernelModules::file(facts));
        loaded.push_back({name, 16384L + 4096L * i, i % 3, {}});
    }
    if (count > 0)
        kernelModules::index();
    kernelModules::load(loaded);
}

void systemLog(int lines)
{
    machine::write("/var/log/messages", "");
    std::ofstream log("/var/log/messages");
    constexpr std::size_t length = 100; // with its end
    for (int i = 0; i < lines; ++i) {
        std::string line = "Nov 20 10:11:12 host systemd[1]: Started Session " + std::to_string(i);
        line.resize(length - 1, '.');
        log << line << '\n';
    }
}

} // namespace madeUp
