#include "mihost/cli/accounts/AccountFiles.h"

#include "mihost/cli/system/TextFile.h"

#include <algorithm>

namespace mihost
{

std::vector<std::string> fieldsOf(std::string const& line, char separator)
{
    std::vector<std::string> fields;
    std::size_t start = 0;
    for (std::size_t end = 0; end != std::string::npos; start = end + 1) {
        end = line.find(separator, start);
        fields.push_back(line.substr(start, end - start));
    }
    return fields;
}

Record recordIn(std::vector<std::string> const& lines, std::string const& name)
{
    constexpr std::size_t mostFields = 9; // of a shadow record
    if (name.find(':') != std::string::npos)
        return {}; // more than a name
    std::string const start = name + ':';
    for (std::string const& line : lines)
        if (line.compare(0, start.size(), start) == 0) {
            Record record = fieldsOf(line, ':');
            record.resize(std::max(record.size(), mostFields));
            return record;
        }
    return {};
}

Record recordOf(std::string const& file, std::string const& name)
{
    return recordIn(linesOf(contentOf(file)), name);
}

std::vector<std::string> recordNames(std::vector<std::string> const& lines)
{
    std::vector<std::string> names;
    names.reserve(lines.size());
    for (std::string const& line : lines)
        names.push_back(line.substr(0, line.find(':')));
    return names;
}

AccountFiles readAccountFiles()
{
    AccountFiles all;
    for (char const* const path : {accountFile, shadowFile, groupFile, groupShadowFile})
        all[path] = linesOf(contentOf(path));
    return all;
}

} // namespace mihost
