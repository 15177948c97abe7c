// The order of virtual operations, read off the tables of built objects.

#include "tests/contract/recording_host/Loaded.h"

#include <cxxabi.h>
#include <dlfcn.h>
#include <link.h>
#include <memory>
#include <utility>

namespace slots_test
{

struct Free {
    void operator()(char* text) const
    {
        std::free(text);
    }
};

/** The class and the operation without arguments, such as "IC::Node::getStatus". */
std::string operationName(void* code)
{
    Dl_info info{};
    if (dladdr(code, &info) == 0 || !info.dli_sname || info.dli_saddr != code)
        return "none";
    int status = 0;
    std::unique_ptr<char, Free> const text(
        abi::__cxa_demangle(info.dli_sname, nullptr, nullptr, &status));
    if (status != 0)
        return info.dli_sname;
    std::string const name = text.get();
    return name.substr(0, name.find_first_of("([<"));
}

/** All slots of the table that an object points to. */
Lines slotsOf(void const* object)
{
    auto* const table = *static_cast<void* const* const*>(object);
    Dl_info info{};
    void* entry = nullptr;
    if (dladdr1(table, &info, &entry, RTLD_DL_SYMENT) == 0 || !entry)
        return {"no table"};
    // The offset of the whole object and the type information come before the slots.
    std::size_t const count = static_cast<ElfW(Sym) const*>(entry)->st_size / sizeof(void*) - 2;
    Lines names;
    for (std::size_t slot = 0; slot < count; ++slot)
        names.push_back(operationName(table[slot]));
    return names;
}

// The destructor takes two slots of the table: for objects in place and for those made with new.
// The name of a conversion to text begins with the type's full name.

Lines const interfaceSlots = {"IC::ManagementInterface::getMap",
                              "IC::ManagementInterface::initialize",
                              "IC::ManagementInterface::registerForAlerts",
                              "IC::ManagementInterface::setLoadCallBack",
                              "IC::ManagementInterface::deRegisterForAlerts",
                              "IC::ManagementInterface::unload",
                              "IC::ManagementInterface::~ManagementInterface",
                              "IC::ManagementInterface::~ManagementInterface",
                              "IC::ManagementInterface::operator std::__cxx11::basic_string",
                              "IC::ManagementInterface::addNewNode",
                              "IC::ManagementInterface::deleteNode",
                              "IC::ManagementInterface::getNode"};

Lines const nodeSlots = {
    "IC::MutableNode::~MutableNode", "IC::MutableNode::~MutableNode",
    "IC::MutableNode::getStatus",    "IC::MutableNode::getDescription",
    "IC::MutableNode::getProperty",  "IC::MutableNode::getProperties",
    "IC::MutableNode::setProperty",  "IC::Node::operator std::__cxx11::basic_string",
    "IC::MutableNode::getNodeId",    "IC::MutableNode::getLinkedId",
    "IC::MutableNode::getIndex",     "IC::MutableNode::getMIIds",
    "IC::MutableNode::addMI",        "IC::MutableNode::delMI",
    "IC::MutableNode::setStatus",    "IC::MutableNode::setDescription",
    "IC::MutableNode::setPath",      "IC::MutableNode::setParent"};

std::string inClass(std::string const& name, std::string const& operation)
{
    return std::string("IC::").append(name).append("::").append(operation);
}

/** The slots of a class derived from one with these, with some of its operations overridden. */
Lines overridden(Lines slots, std::string const& base, std::string const& derived,
                 Lines const& operations)
{
    for (std::string& slot : slots) {
        for (std::string const& operation : operations)
            if (slot == inClass(base, operation))
                slot = inClass(derived, operation);
        if (slot == inClass(base, "~" + base))
            slot = inClass(derived, "~" + derived);
    }
    return slots;
}

class Slots : public Loaded
{
};

TEST_F(Slots, AreInOrderAndOfThePluginDifferInWhatItOverrides)
{
    IC::ManagementInterface const interface;
    EXPECT_EQ(slotsOf(&interface), interfaceSlots);
    IC::MutableNode const node(1, 0, {1}, 39, 0);
    EXPECT_EQ(slotsOf(&node), nodeSlots);
    EXPECT_EQ(slotsOf(&plugin.interface()), overridden(interfaceSlots, "ManagementInterface",
                                                       "OsSwMI", {"initialize", "unload"}));
}

TEST_F(Slots, OfANodeClassDifferInWhatItOverrides)
{
    Lines const both{"getProperty", "setProperty"};
    for (auto const& [name, overrides] : {std::pair{"OsNode", both},
                                          {"UserNode", both},
                                          {"GroupNode", Lines{"getProperty"}},
                                          {"LogEntryNode", both}}) {
        std::unique_ptr<IC::MutableNode> const node(construct(name));
        EXPECT_EQ(slotsOf(node.get()), overridden(nodeSlots, "MutableNode", name, overrides));
    }
}

} // namespace slots_test
