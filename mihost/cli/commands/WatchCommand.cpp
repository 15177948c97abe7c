#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/plugin/Session.h"
#include "mihost/cli/system/SignalWaiter.h"
#include "mihost/cli/system/Stderr.h"

#include <cmath>
#include <cstdlib>
#include <map>

namespace mihost
{

namespace
{

/** A range alone accepts what is not a number. */
std::string objectionToNan(std::string const& text)
{
    return std::isnan(std::strtod(text.c_str(), nullptr)) ? text + " is not a number" : "";
}

class Watch : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_, "an id, or a name such as os or log:1; see 'mihost tree'")
            ->required();
        app.add_option("PROPERTY", names_, "ids or names, see 'mihost properties'")->required();
        app.add_option("--interval", interval_, "wait S seconds between readings")
            ->check(CLI::Range(0.0, 86400.0))
            ->check(objectionToNan)
            ->type_name("S")
            ->capture_default_str();
        app.add_option("-n,--count", count_, "stop after N readings; 0 means never")
            ->type_name("N")
            ->capture_default_str();
    }

    void run(Session& session) override
    {
        IC::MutableNode const& node = session.node(address_);
        SignalWaiter signals;
        std::map<unsigned int, std::string> last;
        for (unsigned int reading = 1;; ++reading) {
            NodeView view = liveView(node, names_, session.secrets());
            // Ctrl-C reaches the commands, too: what was read then is not to be shown.
            if (!goesOn(session.out(), signals, 0))
                return;
            std::vector<PropertyView> changed;
            for (PropertyView const& property : view.properties) {
                std::string const text = static_cast<std::string>(property.value);
                auto const [entry, isNew] = last.try_emplace(property.id, text);
                if (isNew || entry->second != text)
                    changed.push_back(property);
                entry->second = text;
            }
            view.properties = changed;
            show(session, view);
            if (reading == 1)
                Session::warnOfUnknown();
            else
                takeUnknownWarning(); // it was given
            if (reading == count_ || !goesOn(session.out(), signals, interval_))
                return;
        }
    }

private:
    /**
     * Waits.
     *
     * @return whether the watch goes on
     * @throws OutputClosed, which without a change would never be noticed
     */
    static bool goesOn(Output const& out, SignalWaiter& signals, double seconds)
    {
        auto const event = signals.wait({out.descriptor(), 0, 0}, seconds);
        if (event == SignalWaiter::Event::Ready)
            throw OutputClosed();
        if (event == SignalWaiter::Event::Signal && terminal::canAsk())
            writeStderr("\n"); // the terminal shows ^C
        return event == SignalWaiter::Event::Timeout;
    }

    static void show(Session& session, NodeView const& view)
    {
        if (view.properties.empty())
            return;
        if (session.options().json)
            session.out().json(toJson(view));
        else
            writeProperties(view.properties, "", session.out());
        session.out().flush();
    }

    std::string address_;
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
        {"mihost watch os physical-memory-free -n 2", "stop after two readings"},
        {"mihost watch log:1 message --interval 0.5 -n 2", "read twice a second"},
    },
};

} // namespace mihost
