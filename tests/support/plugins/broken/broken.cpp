// The plug-in's own objects and a layer between them and the host that breaks the contract in the
// way that the environment variable BROKEN names; in no way if it is not set. The linker redirects
// the calls to this layer (--wrap), so no code of the plug-in is repeated here.

#include "frame/OsSwMI.h"
#include "host/OpenMI.h"
#include "host/Properties.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <stdexcept>
#include <string>
#include <unistd.h>
#include <vector>

#define WRAPPER(symbol) __asm__("__wrap_" symbol)
#define WRAPPED(symbol) __asm__("__real_" symbol)

#define STRING "NSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEE"
#define LOG_ARGUMENTS "EPKcS2_iRKNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEEiPciiSA_"

namespace
{

bool isBroken(char const* way)
{
    char const* const broken = std::getenv("BROKEN");
    return broken && std::string(broken) == way;
}

// What the host has done so far.
bool initialized = false;
bool initializeFailed = false;
bool methodCalled = false;

// What the library still keeps after the host has unloaded it.
auto& lost = *new std::vector<std::string>;

struct Message {
    char const* function;
    char const* file;
    int line;
    std::string category;
    int level;
    std::string text;
};

Message distorted(char const* function, char const* file, int line, std::string const& category,
                  int level, std::string const& text)
{
    Message message{function, file, line, category, level, text};
    if (text != "createRootNode: entry")
        return message;
    if (isBroken("level"))
        message.level = 1;
    if (isBroken("category"))
        message.category = "Veltrix.IC.MI.Other";
    if (isBroken("line"))
        message.line = 0;
    return message;
}

bool isSwallowed(std::string const& text)
{
    return isBroken("exit") && text == "createRootNode: exit";
}

} // namespace

// --- The logger

void realLog(char const*, char const*, int, std::string const&, int, char*, int, int,
             std::string const&) WRAPPED("_ZN5VXLog8VXLogger15logLevelMessage" LOG_ARGUMENTS);
void wrappedLog(char const*, char const*, int, std::string const&, int, char*, int, int,
                std::string const&) WRAPPER("_ZN5VXLog8VXLogger15logLevelMessage" LOG_ARGUMENTS);
void realTrace(char const*, char const*, int, std::string const&, int, char*, int, int,
               std::string const&) WRAPPED("_ZN5VXLog8VXLogger17traceLevelMessage" LOG_ARGUMENTS);
void wrappedTrace(char const*, char const*, int, std::string const&, int, char*, int, int,
                  std::string const&)
    WRAPPER("_ZN5VXLog8VXLogger17traceLevelMessage" LOG_ARGUMENTS);

void wrappedLog(char const* function, char const* file, int line, std::string const& category,
                int level, char* extra, int first, int second, std::string const& text)
{
    if (isSwallowed(text))
        return;
    Message const message = distorted(function, file, line, category, level, text);
    realLog(message.function, message.file, message.line, message.category, message.level, extra,
            first, second, message.text);
}

void wrappedTrace(char const* function, char const* file, int line, std::string const& category,
                  int level, char* extra, int first, int second, std::string const& text)
{
    if (isSwallowed(text) || (isBroken("trace") && text == "createRootNode: entry"))
        return;
    Message const message = distorted(function, file, line, category, level, text);
    realTrace(message.function, message.file, message.line, message.category, message.level, extra,
              first, second, message.text);
}

// --- The framework

IC::Error realInitialize(IC::ManagementInterface*, unsigned int, IC::Number const&,
                         IC::Number const&)
    WRAPPED("_ZN2IC19ManagementInterface10initializeEjRKNS_6NumberES3_");
IC::Error wrappedInitialize(IC::ManagementInterface*, unsigned int, IC::Number const&,
                            IC::Number const&)
    WRAPPER("_ZN2IC19ManagementInterface10initializeEjRKNS_6NumberES3_");
void realUnload(IC::ManagementInterface*) WRAPPED("_ZN2IC19ManagementInterface6unloadEv");
void wrappedUnload(IC::ManagementInterface*) WRAPPER("_ZN2IC19ManagementInterface6unloadEv");

IC::Error wrappedInitialize(IC::ManagementInterface* self, unsigned int first,
                            IC::Number const& second, IC::Number const& third)
{
    initialized = true;
    unsigned int const id = isBroken("own-id") ? 1 : first;
    IC::Error const error = realInitialize(self, id, second, third);
    initializeFailed = error.getStatus() != 0;
    if (isBroken("exception"))
        throw std::runtime_error("thrown by the plug-in");
    return isBroken("hidden-failure") ? IC::Error(0, IC::Number(0U), "") : error;
}

void wrappedUnload(IC::ManagementInterface* self)
{
    if (isBroken("early-unload") && !initialized)
        raise(SIGUSR1); // a sanitizer would catch SIGSEGV
    if (isBroken("exit-at-unload"))
        _exit(3);
    if (!isBroken("kept-nodes"))
        realUnload(self);
}

// --- Nodes and their values

void realNode(IC::MutableNode*, unsigned int, unsigned int, std::vector<unsigned int>, unsigned int,
              unsigned int) WRAPPED("_ZN2IC11MutableNodeC2EjjSt6vectorIjSaIjEEjj");
void wrappedNode(IC::MutableNode*, unsigned int, unsigned int, std::vector<unsigned int>,
                 unsigned int, unsigned int) WRAPPER("_ZN2IC11MutableNodeC2EjjSt6vectorIjSaIjEEjj");
IC::Error realDescription(IC::MutableNode*, std::string const&)
    WRAPPED("_ZN2IC11MutableNode14setDescriptionERK" STRING);
IC::Error wrappedDescription(IC::MutableNode*, std::string const&)
    WRAPPER("_ZN2IC11MutableNode14setDescriptionERK" STRING);
IC::Error realProperty(IC::MutableNode*, unsigned int const&, IC::PropertyValue const&)
    WRAPPED("_ZN2IC11MutableNode11setPropertyERKjRKNS_13PropertyValueE");
IC::Error wrappedProperty(IC::MutableNode*, unsigned int const&, IC::PropertyValue const&)
    WRAPPER("_ZN2IC11MutableNode11setPropertyERKjRKNS_13PropertyValueE");
void realEnumeration(IC::PropertyValue*, IC::EnumValue const&, bool const&)
    WRAPPED("_ZN2IC13PropertyValueC1ERKNS_9EnumValueERKb");
void wrappedEnumeration(IC::PropertyValue*, IC::EnumValue const&, bool const&)
    WRAPPER("_ZN2IC13PropertyValueC1ERKNS_9EnumValueERKb");

void wrappedNode(IC::MutableNode* self, unsigned int id, unsigned int parent,
                 std::vector<unsigned int> miIds, unsigned int type, unsigned int index)
{
    if (isBroken("index") && type == IC::nodeType::group)
        --index;
    if (isBroken("parent") && type == IC::nodeType::group)
        --parent;
    realNode(self, id, parent, miIds, type, index);
}

IC::Error wrappedDescription(IC::MutableNode* self, std::string const& description)
{
    bool const other =
        isBroken("description") && self->getNodeType() == IC::nodeType::operatingSystem;
    return realDescription(self, other ? "A System" : description);
}

IC::Error wrappedProperty(IC::MutableNode* self, unsigned int const& id,
                          IC::PropertyValue const& value)
{
    bool const ofGroup = self->getNodeType() == IC::nodeType::group;
    if (isBroken("kind") && ofGroup && id == IC::property::id)
        return realProperty(self, id, IC::PropertyValue(static_cast<std::string>(value), true));
    if (isBroken("missing-property") && ofGroup && id == IC::property::members)
        return {0, IC::Number(0U), ""};
    if (isBroken("length") && self->getNodeType() == IC::nodeType::user &&
        id == IC::property::nameLength)
        return realProperty(self, id, IC::PropertyValue(IC::Number(99U), true));
    return realProperty(self, id, value);
}

void wrappedEnumeration(IC::PropertyValue* self, IC::EnumValue const& value, bool const& flag)
{
    realEnumeration(self, value, isBroken("flag") || flag);
}

// --- The builders and the methods

void realUsers(IC::OsSwMI*, bool) WRAPPED("_ZN2IC6OsSwMI15createUserNodesEb");
void wrappedUsers(IC::OsSwMI*, bool) WRAPPER("_ZN2IC6OsSwMI15createUserNodesEb");
void realGroups(IC::OsSwMI*, bool) WRAPPED("_ZN2IC6OsSwMI16createGroupNodesEb");
void wrappedGroups(IC::OsSwMI*, bool) WRAPPER("_ZN2IC6OsSwMI16createGroupNodesEb");
void realLogNode(IC::OsSwMI*) WRAPPED("_ZN2IC6OsSwMI14createLogNodesEv");
void wrappedLogNode(IC::OsSwMI*) WRAPPER("_ZN2IC6OsSwMI14createLogNodesEv");
void realEntries(IC::OsSwMI*, bool) WRAPPED("_ZN2IC6OsSwMI19createLogEntryNodesEb");
void wrappedEntries(IC::OsSwMI*, bool) WRAPPER("_ZN2IC6OsSwMI19createLogEntryNodesEb");
void realPublish(IC::OsSwMI*, IC::Node*) WRAPPED("_ZN2IC6OsSwMI11publishNodeEPNS_4NodeE");
void wrappedPublish(IC::OsSwMI*, IC::Node*) WRAPPER("_ZN2IC6OsSwMI11publishNodeEPNS_4NodeE");
bool realMethod(void*, std::string) WRAPPED("_ZN2NQ6OsInfo13setCreateUserE" STRING);
bool wrappedMethod(void*, std::string) WRAPPER("_ZN2NQ6OsInfo13setCreateUserE" STRING);

void wrappedUsers(IC::OsSwMI* self, bool refresh)
{
    if (isBroken("abort") && refresh) {
        std::fputs("the plug-in gives up\n", stderr);
        std::abort();
    }
    while (isBroken("hang") && initializeFailed)
        pause();
    if (isBroken("children") && fork() == 0)
        _exit(0);
    if (isBroken("no-deletion"))
        refresh = false;
    if (isBroken("memory"))
        lost.emplace_back(100000, 'x');
    realUsers(self, refresh);
}

void wrappedGroups(IC::OsSwMI* self, bool refresh)
{
    if (!(isBroken("stale-groups") && methodCalled))
        realGroups(self, refresh);
}

void wrappedLogNode(IC::OsSwMI* self)
{
    if (!(isBroken("no-tree") && initializeFailed))
        realLogNode(self);
}

void wrappedEntries(IC::OsSwMI* self, bool refresh)
{
    if (!(isBroken("no-tree") && initializeFailed))
        realEntries(self, refresh);
}

void wrappedPublish(IC::OsSwMI* self, IC::Node* node)
{
    if (isBroken("unpublished"))
        return;
    if (isBroken("published-twice"))
        realPublish(self, node);
    if (isBroken("silent-refusal"))
        self->addNewNode(node);
    else
        realPublish(self, node);
}

bool wrappedMethod(void* self, std::string text)
{
    methodCalled = true;
    return realMethod(self, text) || isBroken("method-success");
}

// --- libc

int realClose(std::FILE*) WRAPPED("pclose");
int wrappedClose(std::FILE*) WRAPPER("pclose");

int wrappedClose(std::FILE* stream)
{
    return isBroken("descriptors") ? 0 : realClose(stream);
}

// --- The entry point, in place of the plug-in's own

extern "C" int OpenMI(IC::ManagementInterface** interface, IC::Error** error)
{
    static IC::Error other(0, IC::Number(0U), "");
    static bool called = false;
    *interface = &IC::OSSWMI::myosswmi;
    *error = isBroken("entry-point") && called ? &other : &IC::OSSWMI::myerr;
    called = true;
    return 0;
}
