// What derived classes rely on: virtual operations in order, type information, protected members.

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "mihost/hostcheck/Check.h"

#include <cstdlib>
#include <cxxabi.h>
#include <dlfcn.h>
#include <link.h>
#include <memory>
#include <typeinfo>

namespace hostcheck
{

namespace
{

#define STRING_REF "RKNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEE"

struct Slot {
    char const* name;
    char const* symbol; // null if hosts need not export one
};

// A destructor has two slots: for destruction in place and for delete.

constexpr Slot interfaceSlots[] = {
    {"getMap", "_ZN2IC19ManagementInterface6getMapERSt6vectorIPNS_4NodeESaIS3_EE"},
    {"initialize", "_ZN2IC19ManagementInterface10initializeEjRKNS_6NumberES3_"},
    {"registerForAlerts", "_ZN2IC19ManagementInterface17registerForAlertsEPFNS_5ErrorE"
                          "RKSt6vectorINS_5AlertESaIS3_EEPKvES9_"},
    {"setLoadCallBack", nullptr}, // an inline body
    {"deRegisterForAlerts", "_ZN2IC19ManagementInterface19deRegisterForAlertsEv"},
    {"unload", "_ZN2IC19ManagementInterface6unloadEv"},
    {"~ManagementInterface", nullptr},
    {"~ManagementInterface", nullptr},
    {"operator std::string",
     "_ZNK2IC19ManagementInterfacecvNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEEEv"},
    {"addNewNode", "_ZN2IC19ManagementInterface10addNewNodeERPNS_4NodeE"},
    {"deleteNode", "_ZN2IC19ManagementInterface10deleteNodeEPNS_4NodeE"},
    {"getNode", "_ZN2IC19ManagementInterface7getNodeE" STRING_REF "RPNS_4NodeE"},
};

constexpr Slot nodeSlots[] = {
    {"~MutableNode", nullptr},
    {"~MutableNode", nullptr},
    {"getStatus", "_ZNK2IC11MutableNode9getStatusEv"},
    {"getDescription", "_ZNK2IC11MutableNode14getDescriptionB5cxx11Ev"},
    {"getProperty", "_ZNK2IC11MutableNode11getPropertyEjRNS_13PropertyValueE"},
    {"getProperties", "_ZNK2IC11MutableNode13getPropertiesEv"},
    {"setProperty", "_ZN2IC11MutableNode11setPropertyERKjRKNS_13PropertyValueE"},
    {"operator std::string",
     "_ZNK2IC4NodecvNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEEEv"},
    {"getNodeId", "_ZNK2IC11MutableNode9getNodeIdEv"},
    {"getLinkedId", "_ZNK2IC11MutableNode11getLinkedIdEv"},
    {"getIndex", "_ZNK2IC11MutableNode8getIndexEv"},
    {"getMIIds", "_ZNK2IC11MutableNode8getMIIdsEv"},
    {"addMI", "_ZN2IC11MutableNode5addMIEj"},
    {"delMI", "_ZN2IC11MutableNode5delMIEj"},
    {"setStatus", "_ZN2IC11MutableNode9setStatusERKj"},
    {"setDescription", "_ZN2IC11MutableNode14setDescriptionE" STRING_REF},
    {"setPath", "_ZN2IC11MutableNode7setPathE" STRING_REF},
    {"setParent", "_ZN2IC11MutableNode9setParentE" STRING_REF},
};

struct Free {
    void operator()(char* text) const
    {
        std::free(text);
    }
};

std::string demangled(char const* symbol)
{
    int status = 0;
    std::unique_ptr<char, Free> const text(abi::__cxa_demangle(symbol, nullptr, nullptr, &status));
    return text ? text.get() : symbol;
}

std::string nameOf(void* code)
{
    Dl_info info{};
    bool const known = dladdr(code, &info) != 0 && info.dli_sname && info.dli_saddr == code;
    return known ? demangled(info.dli_sname) : "something without a name";
}

/** @return the number of slots by the symbol table; the expected number if it is unknown */
std::size_t slotCount(void* const* table, std::size_t expected)
{
    Dl_info info{};
    void* entry = nullptr;
    if (dladdr1(table, &info, &entry, RTLD_DL_SYMENT) == 0 || !entry || !info.dli_sname ||
        std::string(info.dli_sname).rfind("_ZTV", 0) != 0)
        return expected;
    // The offset of the whole object and the type information come before the slots.
    return static_cast<ElfW(Sym) const*>(entry)->st_size / sizeof(void*) - 2;
}

template <std::size_t Count> std::string slotsAre(Slot const (&slots)[Count], void const* object)
{
    auto* const table = *static_cast<void* const* const*>(object);
    std::size_t const count = slotCount(table, Count);
    for (std::size_t at = 0; at < Count && at < count; ++at) {
        if (!slots[at].symbol)
            continue;
        void* const expected = dlsym(RTLD_DEFAULT, slots[at].symbol);
        if (!expected)
            return std::string(slots[at].name) + " is not exported";
        if (table[at] != expected)
            return "the slot of " + std::string(slots[at].name) + " holds " + nameOf(table[at]);
    }
    return equal("the number of slots", static_cast<long long>(count), Count);
}

std::string interfaceOrder()
{
    IC::ManagementInterface const object;
    return slotsAre(interfaceSlots, &object);
}

std::string nodeOrder()
{
    IC::MutableNode const object(1, 0, {1}, 2, 0);
    return slotsAre(nodeSlots, &object);
}

class DerivedNode : public IC::MutableNode
{
public:
    DerivedNode() : MutableNode(1, 0, {1}, 2, 0) {}
};

class DerivedInterface : public IC::ManagementInterface
{
public:
    using IC::ManagementInterface::loadCallBack_;
    using IC::ManagementInterface::loadCallBackContext_;
    using IC::ManagementInterface::lookupCallBack_;
    using IC::ManagementInterface::nodes_;
};

std::string nodeTypes()
{
    IC::MutableNode plain(1, 0, {1}, 2, 0);
    DerivedNode derived;
    IC::Node& asNode = plain;
    IC::Node& derivedAsNode = derived;
    return firstOf(
        {holds(typeid(asNode) == typeid(IC::MutableNode),
               "typeid of a node that the host constructed is not IC::MutableNode"),
         holds(typeid(derivedAsNode) == typeid(DerivedNode),
               "typeid of a derived node is not its own class"),
         holds(dynamic_cast<IC::MutableNode*>(&asNode) == &plain,
               "dynamic_cast does not find the IC::MutableNode of an IC::Node"),
         holds(dynamic_cast<IC::MutableNode*>(&derivedAsNode) == &derived,
               "dynamic_cast does not find the IC::MutableNode of a derived node"),
         holds(!dynamic_cast<DerivedNode*>(&asNode), "dynamic_cast takes every node for a derived "
                                                     "one")});
}

std::string interfaceTypes()
{
    IC::ManagementInterface plain;
    DerivedInterface derived;
    IC::ManagementInterface& asBase = derived;
    return firstOf({holds(typeid(plain) == typeid(IC::ManagementInterface),
                          "typeid of an interface that the host constructed is not its class"),
                    holds(typeid(asBase) == typeid(DerivedInterface),
                          "typeid of a derived interface is not its own class"),
                    holds(dynamic_cast<DerivedInterface*>(&asBase) == &derived,
                          "dynamic_cast does not find the derived interface")});
}

IC::Error loaded(IC::Node* const&, void const*)
{
    return {0, IC::Number(0U), ""};
}

IC::Error lookedUp(std::string const&, IC::Node**)
{
    return {0, IC::Number(0U), ""};
}

std::string callBackMembers()
{
    // The host's own object has the host's own copy of the inline body in its table.
    auto const object = std::make_unique<IC::ManagementInterface>();
    object->setLoadCallBack(loaded, &object, lookedUp);
    return firstOf({holds((*object).*(&DerivedInterface::loadCallBack_) == loaded,
                          "loadCallBack_ is not the first argument"),
                    holds((*object).*(&DerivedInterface::loadCallBackContext_) == &object,
                          "loadCallBackContext_ is not the second argument"),
                    holds((*object).*(&DerivedInterface::lookupCallBack_) == lookedUp,
                          "lookupCallBack_ is not the third argument")});
}

std::string nodeListMember()
{
    DerivedInterface object;
    auto* const node = new IC::MutableNode(1, 0, {1}, 2, 0);
    object.nodes_.push_back(node);
    std::vector<IC::Node*> nodes;
    object.getMap(nodes);
    bool const found = nodes == std::vector<IC::Node*>{node};
    object.unload();
    return holds(found, "a node appended to nodes_ is not in the list that getMap returns");
}

} // namespace

Checks slotChecks()
{
    return {
        {"IC::MutableNode", "has its virtual operations in order", nodeOrder},
        {"IC::ManagementInterface", "has its virtual operations in order", interfaceOrder},
        {"IC::MutableNode", "has type information that both sides share", nodeTypes},
        {"IC::ManagementInterface", "has type information that both sides share", interfaceTypes},
        {"IC::ManagementInterface::setLoadCallBack", "stores its arguments in three members",
         callBackMembers},
        {"IC::ManagementInterface::nodes_", "is the list that getMap returns", nodeListMember},
    };
}

} // namespace hostcheck
