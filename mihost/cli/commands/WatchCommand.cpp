#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/commands/Repetition.h"
#include "mihost/cli/input/Address.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Range.h"
#include "mihost/cli/output/NodeJson.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/Stderr.h"

#include <ctime>
#include <fmt/format.h>
#include <map>
#include <utility>

namespace mihost
{

namespace
{

class Watch : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_, "an id, or a name such as os or log:1; see 'mihost tree'")
            ->required();
        app.add_option("PROPERTY", names_, "ids or names, see 'mihost properties'")->required();
        app.add_option("--interval", interval_, "wait S seconds between reads")
            ->check(between(0, 86400))
            ->type_name("S")
            ->capture_default_str();
        app.add_option("-n,--count", count_, "stop after N reads; 0 means never")
            ->check(wholeBetween(0, 1000000000))
            ->type_name("N")
            ->capture_default_str();
    }

    void run(Session& session) override
    {
        IC::MutableNode const& node = session.node(address_);
        id_ = node.getNodeId();
        address_ = addressOf(node);
        SignalWaiter signals;
        std::map<unsigned int, std::string> last;
        bool isThere = true;
        for (unsigned int reading = 1;; ++reading) {
            NodeView view = readNode(session, isThere);
            // Ctrl-C also reaches the commands, so this read is incomplete and not shown.
            if (!waitForNextRound(session.out(), signals, 0))
                return;
            view.properties = changedOf(view, last);
            show(session, view);
            if (reading == 1)
                Session::warnOfUnknown();
            else
                takeUnknownWarning(); // the warning was given already
            if (reading == count_ || !waitForNextRound(session.out(), signals, interval_))
                return;
        }
    }

private:
    /** The node, or the one of its name that the plug-in built in its place; null for none. */
    IC::MutableNode const* findAgain(std::vector<IC::MutableNode*> const& nodes) const
    {
        IC::MutableNode const* found = nullptr;
        for (IC::MutableNode const* node : nodes) {
            if (node->getNodeId() == id_)
                return node;
            if (!found && addressOf(*node) == address_)
                found = node;
        }
        return found;
    }

    /** Nothing while the plug-in does not have the node, which is reported once. */
    NodeView readNode(Session& session, bool& isThere) const
    {
        IC::MutableNode const* const node = findAgain(session.nodes());
        bool const wasThere = std::exchange(isThere, node != nullptr);
        if (node)
            return liveView(*node, names_, session.secrets());
        if (wasThere)
            warn(fmt::format("watch: node '{}' is gone (waiting for it)", address_));
        return {nullptr, {}};
    }

    static std::vector<PropertyView> changedOf(NodeView const& view,
                                               std::map<unsigned int, std::string>& last)
    {
        std::vector<PropertyView> changed;
        for (PropertyView const& property : view.properties) {
            std::string const text = static_cast<std::string>(property.value);
            auto const [entry, isNew] = last.try_emplace(property.id, text);
            if (isNew || entry->second != text)
                changed.push_back(property);
            entry->second = text;
        }
        return changed;
    }

    static void show(Session& session, NodeView const& view)
    {
        if (view.properties.empty())
            return;
        long const now = std::time(nullptr);
        if (session.out().takesDocuments()) {
            Json document = {{"time", now}};
            document.update(toJson(view));
            session.out().json(document);
        } else {
            writeProperties(view.properties, timeText(now) + "  ", session.out());
        }
        session.out().flush();
    }

    std::string address_;
    unsigned int id_ = 0;
    std::vector<std::string> names_;
    double interval_ = 1;
    unsigned int count_ = 0;
};

} // namespace

CommandRow const commandRows::watch{
    "watch",
    "print properties whenever they change",
    newCommand<Watch>,
    {
        {"mihost watch os physical-memory-free -n 2", "stop after two reads"},
        {"mihost watch log:1 message --interval 0.5 -n 2", "read twice a second"},
    },
};

} // namespace mihost
