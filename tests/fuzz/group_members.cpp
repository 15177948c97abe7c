#include "sysdata/groupInfo_members.h"
#include "tests/fuzz/support/System.h"
#include "util/MyProcess.h"

namespace
{

/** @return the members field, built by searching it for each name */
std::string plain(std::string field, std::vector<std::string> const& members)
{
    for (std::string const& name : members)
        if (field.find(name + ",") == std::string::npos)
            field += name + ",";
    if (field.size() > 1)
        field.pop_back();
    return field;
}

std::vector<std::string> names(std::string const& lines)
{
    std::vector<std::string> found;
    NQ::Tokenize(lines, found, std::string("\n\0", 2));
    return found;
}

} // namespace

// Login names whose primary group it is, then those that the group itself lists, one in a line.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    std::vector<std::string> const texts = fuzz::sections(data, size, 2);
    std::string field;
    for (std::string const& name : names(texts[0]))
        field += name + ",";
    std::vector<std::string> const listed = names(texts[1]);
    std::vector<char const*> members;
    for (std::string const& name : listed)
        members.push_back(name.c_str());
    members.push_back(nullptr);
    fuzz::require(NQ::GROUP_INFO::withMembers(field, members.data()) == plain(field, listed));
    return 0;
}
