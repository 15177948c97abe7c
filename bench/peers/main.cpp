// bench_peers [--quick]: other programs that report facts of a machine, on the same machine.
//
// In a copy of this machine, in which their Debian packages are installed and discarded. With 120
// kernel modules and a log of 1,000 lines, run alternately with mihost, with and without the
// accelerator, which always starts the plug-in as a whole:
//
//   with 10 users      facter, ansible's setup module, inxi, snmpwalk of the host resources (once
//                      without and once with the start of its agent); mihost prints its whole tree
//   with 10,000 users  userdbctl, getent; mihost lists users and groups
//
// snmpd runs in its own network namespace.

#include "TestPaths.h"
#include "bench/peers/Loopback.h"
#include "bench/support/MadeUp.h"
#include "bench/support/Samples.h"
#include "bench/support/Table.h"
#include "bench/support/Timed.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <stdexcept>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

constexpr std::size_t rounds = 7;
constexpr std::size_t quickRounds = 2;

struct Peer {
    char const* name;
    std::string command;
    char const* leavesOut; // of the plug-in's facts
};

/** @return the command of an agent that listens only on the loopback of its own network */
std::string agent(std::string const& port)
{
    return "snmpd -f -LF 0 /dev/null -C -r --rocommunity=public udp:127.0.0.1:" + port;
}

/** @return the command to read one part of the host resources: 1 system, 2 storage, 4 processes */
std::string walk(std::string const& port, std::string const& part)
{
    return "snmpwalk -v2c -c public -r 0 -Oq 127.0.0.1:" + port + " .1.3.6.1.2.1.25." + part;
}

std::string walks(std::string const& port)
{
    return walk(port, "1") + " && " + walk(port, "2") + " && " + walk(port, "4");
}

std::string untilItAnswers(std::string const& port)
{
    return "until " + walk(port, "1.1 -t 0.05") + " 2>/dev/null; do sleep 0.01; done";
}

constexpr char const* standing = "16161"; // the port of the agent that runs all the time
constexpr char const* passing = "16162";

std::vector<Peer> const factPeers = {
    {"facter", "facter --json", "accounts, groups, kernel modules, the log, counts of processes"},
    {"ansible's setup", "ansible localhost -m setup",
     "accounts but its own, groups, kernel modules, the log, counts of processes"},
    {"inxi", "inxi -F -c 0",
     "accounts, groups, modules but those of the hardware it knows, the log"},
    {"snmpwalk, agent running", walks(standing), "accounts, groups, kernel modules, the log"},
    {"snmpwalk, agent started",
     agent(passing) + " & " + untilItAnswers(passing) + "; " + walks(passing) +
         " && kill $! && { wait; true; }",
     "accounts, groups, kernel modules, the log"},
};

std::vector<Peer> const accountPeers = {
    {"userdbctl", "userdbctl user --json=short && userdbctl group --json=short",
     "all but accounts and groups; failures allowed at login"},
    {"getent", "getent passwd && getent shadow && getent group",
     "all but accounts and groups; failures allowed at login, members by primary group"},
};

int shell(std::string const& line)
{
    return std::system((line + " >/dev/null 2>&1").c_str());
}

constexpr char const* packages = "facter ansible-core inxi snmpd snmp systemd-userdbd";

/** The copy has no network, so the packages must have been downloaded before. */
void install()
{
    if (shell(std::string("DEBIAN_FRONTEND=noninteractive apt-get -qq --no-download "
                          "--no-install-recommends install ") +
              packages) != 0)
        throw std::runtime_error("the peers' packages cannot be installed; script/bench downloads "
                                 "them");
}

/** Runs snmpd while it exists; the constructor returns when it answers. */
class Agent
{
public:
    Agent() : child_(fork())
    {
        if (child_ == 0) {
            execl("/bin/sh", "sh", "-c", ("exec " + agent(standing)).c_str(), nullptr);
            _exit(127);
        }
        if (shell("timeout 20 sh -c '" + untilItAnswers(standing) + "'") != 0)
            throw std::runtime_error("snmpd does not answer");
    }

    ~Agent()
    {
        kill(child_, SIGTERM);
        waitpid(child_, nullptr, 0);
    }

    Agent(Agent const&) = delete;
    Agent& operator=(Agent const&) = delete;

private:
    pid_t child_;
};

struct Compared {
    Peer const& peer;
    Samples its = {};
    Samples mihost = {};
    Samples plain = {}; // without the accelerator
};

std::string mihostTelling(std::string const& options, std::string const& script)
{
    return "printf '" + script + "' | " + MIHOST_FILE + ' ' + options + " shell";
}

/** @param script  the commands for mihost, one per line */
void compare(std::vector<Peer> const& peers, int users, std::string const& script, bool quick)
{
    madeUp::accounts(users);
    Table table({"With " + number(users) + " users", "Its time, ms", "mihost, ms",
                 "mihost --no-accel, ms", "mihost / its", "mihost --no-accel / its",
                 "It leaves out"});
    for (Peer const& peer : peers) {
        Compared found{peer};
        auto const run = [](std::string const& line) {
            return timed({"/bin/sh", "-c", "{ " + line + "; } >/dev/null"}).whole;
        };
        run(peer.command); // so that its cache is filled
        byTurns(quick ? quickRounds : rounds,
                {[&] { found.its.push_back(run(peer.command)); },
                 [&] { found.mihost.push_back(run(mihostTelling("", script))); },
                 [&] { found.plain.push_back(run(mihostTelling("--no-accel", script))); }});
        table.add({peer.name, shown(found.its), shown(found.mihost), shown(found.plain),
                   shown(ratios(found.mihost, found.its), 3),
                   shown(ratios(found.plain, found.its), 2), peer.leavesOut});
    }
    table.print();
}

void measureAll(bool quick)
{
    Loopback const loopback;
    enterCopy();
    setenv("HOME", "/root", 1);
    setenv("LC_ALL", "C.UTF-8", 1); // without which ansible does not start
    install();
    madeUp::modules(120);
    madeUp::systemLog(1000);
    loopback.enter();
    {
        Agent const agent;
        compare(factPeers, 10, "tree --all\\n", quick);
    }
    compare(accountPeers, 10000, "list users\\nlist groups\\n", quick);
}

} // namespace

int main(int argc, char* argv[])
{
    if (argc == 2 && argv[1] == std::string("--packages")) {
        std::puts(packages);
        return 0;
    }
    return runBench(argc, argv, measureAll);
}
