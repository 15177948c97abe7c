// The catalogue for reading: properties and methods.

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/output/CatalogueText.h"
#include "mihost/cli/plugin/Session.h"

namespace mihost
{

namespace
{

/** The rows of that name, or all rows without a name. */
template <class Rows> auto chosen(Rows const& rows, std::string const& name)
{
    std::vector<typename Rows::value_type const*> result;
    for (auto const& row : rows)
        if (name.empty() || row.name == name)
            result.push_back(&row);
    return result;
}

template <class Rows> Json documentOf(Rows const& rows)
{
    Json document = Json::array();
    for (auto const* row : rows)
        document.push_back(toJson(*row));
    return document;
}

class Properties : public Command
{
public:
    void declare(CLI::App& app) override
    {
        choices_.restrict(app.add_option("KIND", kind_, "such as os or user; all kinds by default"),
                          rowNames(nodeKinds()));
        app.add_flag("--markdown", markdown_, "print all as Markdown");
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        if (markdown_) {
            session.out().write(propertiesDocument());
            return;
        }
        Output& out = session.out();
        auto const kinds = chosen(nodeKinds(), kind_);
        if (out.takesDocuments()) {
            out.json(documentOf(kinds));
        } else if (out.takesRows()) {
            out.table(propertiesTable(kinds));
        } else {
            out.paged([&] {
                for (NodeKind const* kind : kinds)
                    out.lines(kindLines(*kind, out.room()));
            });
        }
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
        app.add_flag("--markdown", markdown_, "print all as Markdown");
    }

    bool hasRows() const override
    {
        return true;
    }

    void run(Session& session) override
    {
        Output& out = session.out();
        if (markdown_) {
            out.write(methodsDocument());
        } else if (out.takesDocuments()) {
            out.json(documentOf(chosen(methods(), method_)));
        } else if (method_.empty()) {
            out.table(methodsTable());
        } else if (out.takesRows()) {
            out.table(parametersTable(*findMethod(method_)));
        } else {
            out.lines(methodLines(*findMethod(method_), out.room()));
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
