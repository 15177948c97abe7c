// The catalogue for reading: properties and methods.

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/CatalogueText.h"
#include "mihost/cli/plugin/Session.h"

namespace mihost
{

namespace
{

void writeLines(std::vector<std::string> const& lines, Output& out)
{
    for (std::string const& line : lines)
        out.line(line);
}

/** The rows of that name, or all where none is given. */
template <class Rows> auto chosen(Rows const& rows, std::string const& name)
{
    std::vector<typename Rows::value_type const*> result;
    for (auto const& row : rows)
        if (name.empty() || row.name == name)
            result.push_back(&row);
    return result;
}

class Properties : public Command
{
public:
    void declare(CLI::App& app) override
    {
        choices_.restrict(app.add_option("KIND", kind_, "such as os or user; all kinds by default"),
                          rowNames(nodeKinds()));
        app.add_flag("--markdown", markdown_, "as docs/properties.md");
    }

    void run(Session& session) override
    {
        if (markdown_) {
            session.out().write(propertiesDocument());
            return;
        }
        Json document = Json::array();
        for (NodeKind const* kind : chosen(nodeKinds(), kind_)) {
            if (session.options().json)
                document.push_back(toJson(*kind));
            else
                writeLines(kindLines(*kind, session.out().room()), session.out());
        }
        if (session.options().json)
            session.out().json(document);
    }

private:
    std::string kind_;
    bool markdown_ = false;
};

class Methods : public Command
{
public:
    void declare(CLI::App& app) override
    {
        choices_.restrict(
            app.add_option("METHOD", method_, "such as UserAdd; a list of all by default"),
            rowNames(methods()));
        app.add_flag("--markdown", markdown_, "as docs/methods.md");
    }

    void run(Session& session) override
    {
        Output& out = session.out();
        if (markdown_) {
            out.write(methodsDocument());
        } else if (session.options().json) {
            Json document = Json::array();
            for (Method const* method : chosen(methods(), method_))
                document.push_back(toJson(*method));
            out.json(document);
        } else if (method_.empty()) {
            writeLines(methodListLines(out.room()), out);
        } else {
            writeLines(methodLines(*findMethod(method_), out.room()), out);
        }
    }

private:
    std::string method_;
    bool markdown_ = false;
};

} // namespace

CommandRow const commandRows::properties{
    "properties",
    "describe the properties of each kind of node",
    newCommand<Properties>,
    {
        {"mihost properties user", "the properties of user nodes"},
        {"mihost --json properties", "all of them as JSON"},
    },
};

CommandRow const commandRows::methods{
    "methods",
    "describe the administration methods",
    newCommand<Methods>,
    {
        {"mihost methods", "the methods"},
        {"mihost methods UserAdd", "the parameters of one method"},
    },
};

} // namespace mihost
