#include "mihost/cli/accounts/LocalNames.h"

#include "host/Methods.h"
#include "host/Properties.h"
#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/accounts/LoginDefs.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/system/TextFile.h"

namespace mihost
{

namespace
{

/** The names of the records whose third field is an id that the plug-in has a node for. */
std::vector<std::string> accounts(char const* path, IdRange const& range)
{
    std::vector<std::string> names;
    for (std::string const& line : linesOf(contentOf(path))) {
        Record const record = fieldsOf(line, ':');
        auto const id = record.size() > 2 ? parseDecimal(record[2]) : std::nullopt;
        if (id && range.holds(*id))
            names.push_back(record[0]);
    }
    return names;
}

std::vector<std::string> modules()
{
    std::vector<std::string> names;
    for (std::string const& line : linesOf(contentOf("/proc/modules")))
        names.push_back(line.substr(0, line.find(' ')));
    return names;
}

} // namespace

std::vector<std::string> localNames(NodeKind const& kind)
{
    switch (kind.type) {
    case IC::nodeType::user:
        return accounts(accountFile, readLoginDefs().users());
    case IC::nodeType::group:
        return accounts(groupFile, readLoginDefs().groups());
    case IC::nodeType::driver:
        return modules();
    default:
        return {};
    }
}

} // namespace mihost
