// The command properties of the operating-system node as commands.

#include "host/Properties.h"
#include "mihost/cli/change/Clearance.h"
#include "mihost/cli/change/PropertyWrite.h"
#include "mihost/cli/commands/CommandRows.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

IC::PropertyValue number(unsigned int value)
{
    return {IC::Number(value), true};
}

std::size_t countOf(std::vector<IC::MutableNode*> const& nodes, unsigned int type)
{
    std::size_t count = 0;
    for (IC::MutableNode const* node : nodes)
        if (node->getNodeType() == type)
            ++count;
    return count;
}

std::string counted(std::size_t count, char const* one, char const* several)
{
    return fmt::format("{} {}", count, count == 1 ? one : several);
}

/** @param command  as typed, such as "power halt" */
void clearAndCarryOut(Session& session, std::string const& command, unsigned int property,
                      IC::PropertyValue const& value)
{
    IC::MutableNode& os = session.node("os");
    ChangeLock const lock = clearChange(session, command, dangerOf(os, property, value));
    carryOut(session, osWrite(session, os, command, property, value));
}

class Refresh : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        carryOut(session, osWrite(session, session.node("os"), "refresh", IC::property::refresh,
                                  number(IC::command::rebuild)));
        if (session.out().takesDocuments())
            return;
        auto const nodes = session.nodes();
        session.out().line(
            fmt::format("{}, {}", counted(countOf(nodes, IC::nodeType::user), "user", "users"),
                        counted(countOf(nodes, IC::nodeType::group), "group", "groups")));
    }
};

class ClearLog : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        clearAndCarryOut(session, "clear-log", IC::property::clearLog,
                         number(IC::command::emptyLog));
        if (session.out().takesDocuments())
            return;
        session.out().line(
            counted(countOf(session.nodes(), IC::nodeType::logEntry), "log entry", "log entries"));
    }
};

constexpr char restart[] = "restart";
constexpr char halt[] = "halt";

class Power : public Command
{
public:
    void declare(CLI::App& app) override
    {
        choices_
            .restrict(app.add_option("ACTION", action_, "what to do with the machine"),
                      {restart, halt})
            ->required();
    }

    void run(Session& session) override
    {
        unsigned int const state = action_ == restart ? IC::command::restart : IC::command::halt;
        clearAndCarryOut(session, "power " + action_, IC::property::requestedState,
                         IC::PropertyValue(IC::EnumValue(state), true));
    }

private:
    std::string action_;
};

} // namespace

CommandRow const commandRows::refresh{
    "refresh",
    "rebuild the user and group nodes",
    newCommand<Refresh>,
    {
        {"mihost refresh", "read the accounts again"},
        {"mihost --json refresh", "print the result as JSON"},
    },
};

CommandRow const commandRows::clearLog{
    "clear-log",
    "empty the system log",
    newCommand<ClearLog>,
    {
        {"mihost clear-log", "empty the log after a prompt"},
        {"mihost --sandbox clear-log -y", "try it in a sandbox"},
    },
};

CommandRow const commandRows::power{
    "power",
    "restart or halt the machine",
    newCommand<Power>,
    {
        {"mihost power restart", "restart after a prompt"},
        {"mihost power halt -y", "halt without a prompt"},
    },
};

} // namespace mihost
