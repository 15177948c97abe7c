#include "tests/contract/recording_host/RecordingHost.h"

#include "TestPaths.h"
#include "host/Mutex.h"
#include "host/VXLogger.h"
#include "tests/support/Shown.h"
#include "tests/support/Symbols.h"

#include <algorithm>
#include <dlfcn.h>
#include <map>
#include <mutex>

RecordingHost& recordingHost()
{
    static RecordingHost host;
    return host;
}

RecordingHost& freshHost()
{
    return recordingHost() = {};
}

namespace
{

constexpr char const* messageHead = "log: ";

bool isMessage(std::string const& event)
{
    return event.rfind(messageHead, 0) == 0;
}

void note(std::string event)
{
    recordingHost().events.push_back(std::move(event));
}

/** Notes what happens to an object if that object is part of the plug-in's library. */
void noteStatic(void const* object, std::string const& event)
{
    Dl_info info{};
    if (dladdr(object, &info) != 0 && std::string(info.dli_fname) == PLUGIN_FILE)
        note(event);
}

std::string shown(IC::Number const& number)
{
    static constexpr char const* kinds[] = {"empty", "unsigned", "boolean", "date"};
    return kinds[number.getKind()] + (" " + std::to_string(number.getValue()));
}

std::string shown(std::vector<unsigned int> const& numbers)
{
    std::string text;
    for (unsigned int const number : numbers)
        text += (text.empty() ? "" : " ") + std::to_string(number);
    return "[" + text + "]";
}

IC::Error success()
{
    return {0, IC::Number(IC::Number::EmptyKind), ""};
}

IC::Error setterAnswer()
{
    return {recordingHost().setterStatus, IC::Number(IC::Number::EmptyKind), ""};
}

/** The plug-in's logger category as it stands while its library is being loaded or closed. */
std::string category()
{
    void* const library = dlopen(PLUGIN_FILE, RTLD_NOW | RTLD_NOLOAD);
    if (!library)
        return "none";
    auto const* const text =
        static_cast<std::string const*>(findSymbol(library, "IC::OSSWMI::loggerOsSwMI"));
    std::string found = text ? *text : "none";
    dlclose(library);
    return found;
}

} // namespace

std::vector<std::string> RecordingHost::calls() const
{
    std::vector<std::string> found;
    std::remove_copy_if(events.begin(), events.end(), std::back_inserter(found), isMessage);
    return found;
}

std::vector<std::string> RecordingHost::messages() const
{
    std::vector<std::string> found;
    for (LogCall const& call : logCalls)
        if (call.operation == "log")
            found.push_back(call.message);
    return found;
}

std::vector<std::string> RecordingHost::messages(int level) const
{
    std::vector<std::string> found;
    for (LogCall const& call : logCalls)
        if (call.operation == "log" && call.level == level)
            found.push_back(call.message);
    return found;
}

namespace IC
{

// The interface and its framework.

struct ManagementInterface::Own {
};

ManagementInterface::ManagementInterface()
    : nextNodeId_(0), miId_(0), loadCallBack_(nullptr), loadCallBackContext_(nullptr),
      lookupCallBack_(nullptr)
{
    noteStatic(this, "ManagementInterface(), category " + category());
}

ManagementInterface::~ManagementInterface()
{
    noteStatic(this, "~ManagementInterface(), category " + category());
}

Error ManagementInterface::getMap(std::vector<Node*>& nodes)
{
    nodes = nodes_;
    return success();
}

Error ManagementInterface::initialize(unsigned int first, Number const& second, Number const& third)
{
    RecordingHost& host = recordingHost();
    note("initialize(" + std::to_string(first) + ", " + shown(second) + ", " + shown(third) + ")");
    if (host.onInitialize)
        host.onInitialize();
    miId_ = first;
    miIds_ = host.miIds.empty() ? std::vector<unsigned int>{first} : host.miIds;
    nextNodeId_ = first + 1;
    return {host.initializeStatus, Number(0U), host.initializeStatus == 0 ? "" : "not ready"};
}

Error ManagementInterface::registerForAlerts(AlertCallBack, void const*)
{
    note("registerForAlerts()");
    return success();
}

Error ManagementInterface::deRegisterForAlerts()
{
    note("deRegisterForAlerts()");
    return success();
}

void ManagementInterface::unload()
{
    note("unload()");
    if (recordingHost().onUnload)
        recordingHost().onUnload();
    for (Node* node : nodes_)
        delete node;
    nodes_.clear();
}

ManagementInterface::operator std::string() const
{
    return "interface";
}

Error ManagementInterface::addNewNode(Node*& node)
{
    auto const status = recordingHost().addNewNodeStatus;
    note("addNewNode(" + node->getDescription() + ")");
    return {status, Number(0U), status == 0 ? "" : "refused"};
}

Error ManagementInterface::deleteNode(Node* node)
{
    note("deleteNode(" + node->getDescription() + ")");
    if (recordingHost().deleteNodeStatus != 0)
        return {recordingHost().deleteNodeStatus, Number(0U), "busy"};
    nodes_.erase(std::find(nodes_.begin(), nodes_.end(), node));
    delete node;
    return success();
}

Error ManagementInterface::getNode(std::string const&, Node*&)
{
    return {1, Number(0U), "never found"};
}

// Nodes.

struct Node::Store {
    unsigned int status = 0;
    std::string description;
    std::map<unsigned int, PropertyValue> properties;
};

Node::Node() : store_(std::make_unique<Store>()) {}

Node::~Node() = default;

unsigned int Node::getStatus() const
{
    return store_->status;
}

std::string Node::getDescription() const
{
    return store_->description;
}

Error Node::getProperty(unsigned int id, PropertyValue& value) const
{
    auto const found = store_->properties.find(id);
    if (found == store_->properties.end())
        return {1, Number(0U), "not set"};
    value = found->second;
    return success();
}

std::map<unsigned int, PropertyValue> Node::getProperties() const
{
    return store_->properties;
}

Error Node::setProperty(unsigned int const& id, PropertyValue const& value)
{
    note("setProperty(" + std::to_string(id) + ", " + ::shown(value) + ")");
    store_->properties.insert_or_assign(id, value);
    return setterAnswer();
}

Node::operator std::string() const
{
    return store_->description;
}

struct MutableNode::Identity {
    unsigned int nodeId;
    unsigned int parentId;
    std::vector<unsigned int> miIds;
    unsigned int nodeType;
    unsigned int index;
};

MutableNode::MutableNode(unsigned int nodeId, unsigned int parentId,
                         std::vector<unsigned int> miIds, unsigned int nodeType, unsigned int index)
    : identity_(new Identity{nodeId, parentId, miIds, nodeType, index})
{
    note("MutableNode(" + std::to_string(nodeId) + ", " + std::to_string(parentId) + ", " +
         shown(miIds) + ", " + std::to_string(nodeType) + ", " + std::to_string(index) + ")");
    if (recordingHost().onNode)
        recordingHost().onNode();
}

MutableNode::~MutableNode()
{
    note("~MutableNode()");
}

unsigned int MutableNode::getStatus() const
{
    return Node::getStatus();
}

std::string MutableNode::getDescription() const
{
    return Node::getDescription();
}

Error MutableNode::getProperty(unsigned int id, PropertyValue& value) const
{
    return Node::getProperty(id, value);
}

std::map<unsigned int, PropertyValue> MutableNode::getProperties() const
{
    return Node::getProperties();
}

Error MutableNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    return Node::setProperty(id, value);
}

unsigned int MutableNode::getNodeId() const
{
    return identity_->nodeId;
}

unsigned int MutableNode::getLinkedId() const
{
    return identity_->parentId;
}

unsigned int MutableNode::getIndex() const
{
    return identity_->index;
}

std::vector<unsigned int> MutableNode::getMIIds() const
{
    return identity_->miIds;
}

void MutableNode::addMI(unsigned int) {}

void MutableNode::delMI(unsigned int) {}

Error MutableNode::setStatus(unsigned int const& status)
{
    note("setStatus(" + std::to_string(status) + ")");
    if (recordingHost().onSetStatus)
        recordingHost().onSetStatus(*this);
    store_->status = status;
    return setterAnswer();
}

Error MutableNode::setDescription(std::string const& description)
{
    note("setDescription(" + description + ")");
    store_->description = description;
    return setterAnswer();
}

Error MutableNode::setPath(std::string const&)
{
    return success();
}

Error MutableNode::setParent(std::string const&)
{
    return success();
}

unsigned int MutableNode::getNodeType() const
{
    return identity_->nodeType;
}

// The status.

Error::Error(unsigned char status, Number const& code, std::string const& text)
    : status_(status), code_(code), text_(text)
{
    std::string const made = "Error(" + std::to_string(static_cast<unsigned int>(status)) + ", " +
                             shown(code) + ", \"" + text + "\")";
    noteStatic(this, made);
    recordingHost().errors.push_back(made);
}

Error::Error(Error const& other) = default;

Error& Error::operator=(Error const& other) = default;

Error::~Error()
{
    noteStatic(this, "~Error()");
}

unsigned char Error::getStatus() const
{
    return status_;
}

Error::operator StatusType() const
{
    return static_cast<StatusType>(status_);
}

Error::operator std::string() const
{
    return "status " + std::to_string(static_cast<unsigned int>(status_)) + ", " + text_;
}

std::string Error::getText() const
{
    return text_;
}

} // namespace IC

namespace NQ
{

struct Mutex::Handle {
    std::mutex mutex;
};

Mutex::Mutex() : handle_(std::make_unique<Handle>())
{
    noteStatic(this, "Mutex()");
}

Mutex::~Mutex()
{
    noteStatic(this, "~Mutex()");
}

int Mutex::lock(unsigned long timeout)
{
    note("lock(" + std::to_string(timeout) + ")");
    handle_->mutex.lock();
    return recordingHost().lockStatus;
}

int Mutex::unlock()
{
    note("unlock()");
    handle_->mutex.unlock();
    return 0;
}

} // namespace NQ

namespace VXLog
{

void VXLogger::logLevelMessage(char const* function, char const* file, int line,
                               std::string const& category, int level, char* extra, int first,
                               int second, std::string const& message)
{
    recordingHost().logCalls.push_back(
        {"log", function, file, line, category, level, extra == nullptr, first, second, message});
    note(messageHead + message);
}

void VXLogger::traceLevelMessage(char const* function, char const* file, int line,
                                 std::string const& category, int level, char* extra, int first,
                                 int second, std::string const& message)
{
    recordingHost().logCalls.push_back(
        {"trace", function, file, line, category, level, extra == nullptr, first, second, message});
}

} // namespace VXLog
