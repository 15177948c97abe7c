// The operating-system node's command properties, under names of their own.

#include "mihost/cli/change/Clearance.h"
#include "mihost/cli/change/PropertyWrite.h"
#include "mihost/cli/commands/makers.h"
#include "nodes/ids.h"

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

class Refresh : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        carryOut(session,
                 osWrite(session, session.node("os"), "refresh", NODES::refresh, number(0)));
        if (session.options().json)
            return;
        auto const nodes = session.nodes();
        session.out().line(
            fmt::format("{}, {}", counted(countOf(nodes, NODES::userType), "user", "users"),
                        counted(countOf(nodes, NODES::groupType), "group", "groups")));
    }
};

class ClearLog : public Command
{
public:
    void declare(CLI::App&) override {}

    void run(Session& session) override
    {
        IC::MutableNode& os = session.node("os");
        ChangeLock const lock = clearChange(session, "empty the system log");
        carryOut(session, osWrite(session, os, "clear-log", NODES::clearLog, number(9)));
        if (session.options().json)
            return;
        session.out().line(
            counted(countOf(session.nodes(), NODES::logEntryType), "log entry", "log entries"));
    }
};

class Power : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("ACTION", action_, "restart or halt")
            ->required()
            ->check(CLI::IsMember({"restart", "halt"}));
    }

    void run(Session& session) override
    {
        unsigned int const state = action_ == "restart" ? 9 : 12;
        IC::MutableNode& os = session.node("os");
        ChangeLock const lock = clearChange(session, action_ + " the machine");
        carryOut(session, osWrite(session, os, "power " + action_, NODES::requestedState,
                                  IC::PropertyValue(IC::EnumValue(state), true)));
    }

private:
    std::string action_;
};

} // namespace

std::unique_ptr<Command> commandMakers::refresh()
{
    return std::make_unique<Refresh>();
}

std::unique_ptr<Command> commandMakers::clearLog()
{
    return std::make_unique<ClearLog>();
}

std::unique_ptr<Command> commandMakers::power()
{
    return std::make_unique<Power>();
}

} // namespace mihost
