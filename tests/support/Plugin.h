#ifndef TESTS_SUPPORT_PLUGIN_H
#define TESTS_SUPPORT_PLUGIN_H

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"

#include <optional>
#include <string>
#include <vector>

/**
 * The plug-in's library, loaded as a host loads it: opened, its interface obtained, unloaded if
 * it was initialised, closed.
 *
 * Nodes belong to the plug-in's framework; a pointer to one is good until a rebuild or unload.
 */
class Plugin
{
public:
    /** The plug-in of this build. @throws std::runtime_error if it cannot be loaded */
    Plugin();

    /** Another library. @throws as above */
    explicit Plugin(char const* file);
    ~Plugin();
    Plugin(Plugin const&) = delete;
    Plugin& operator=(Plugin const&) = delete;

    IC::ManagementInterface& interface() const;

    /** The status object from OpenMI. */
    IC::Error const& status() const;

    IC::Error initialize(unsigned int first = 1);
    void unload();

    /**
     * @return the address of one of the library's own symbols, null if it has none of this name
     *
     * @param name  as in C++, such as "IC::OsSwMI::createUserNodes(bool)", or the linker's name
     */
    void* symbol(std::string const& name) const;

    /** @return all nodes, in the order of the framework's list */
    std::vector<IC::MutableNode*> nodes() const;

    /** Those of one node type, see host/Properties.h. */
    std::vector<IC::MutableNode*> nodes(unsigned int type) const;

    /** @throws std::runtime_error unless there is exactly one of this type */
    IC::MutableNode& node(unsigned int type) const;

    /** @return the first of this type whose property 108 is this text; null if there is none */
    IC::MutableNode* find(unsigned int type, std::string const& name) const;

    /** As find. @throws std::runtime_error if there is none */
    IC::MutableNode& node(unsigned int type, std::string const& name) const;

private:
    void* library_;
    IC::ManagementInterface* interface_ = nullptr;
    IC::Error* status_ = nullptr;
    bool initialized_ = false;
};

/** @return what a node answers now; nothing if the status is not 0 */
std::optional<IC::PropertyValue> property(IC::MutableNode const& node, unsigned int id);

/** @return what a node answers now, as text; "(status 1)" for example if it is not 0 */
std::string text(IC::MutableNode const& node, unsigned int id);

/** @return what a node stores, not what its getProperty answers; "(unset)" if nothing */
std::string stored(IC::MutableNode const& node, unsigned int id);

#endif
