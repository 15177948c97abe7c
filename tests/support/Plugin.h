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
     * The address of one of the library's own symbols, null if it has none of this name.
     *
     * @param name  as C++ writes it, such as "IC::OsSwMI::createUserNodes(bool)", or as the linker
     */
    void* symbol(std::string const& name) const;

    /** All nodes in the order of the framework's list. */
    std::vector<IC::MutableNode*> nodes() const;

    /** Those of one node type, see host/Properties.h. */
    std::vector<IC::MutableNode*> nodes(unsigned int type) const;

    /** @throws std::runtime_error where there is not exactly one of this type */
    IC::MutableNode& node(unsigned int type) const;

    /** The first of this type whose property 108 has this text, null where there is none. */
    IC::MutableNode* find(unsigned int type, std::string const& name) const;

    /** As find. @throws std::runtime_error where there is none */
    IC::MutableNode& node(unsigned int type, std::string const& name) const;

private:
    void* library_;
    IC::ManagementInterface* interface_ = nullptr;
    IC::Error* status_ = nullptr;
    bool initialized_ = false;
};

/** What a node answers now; nothing where the status is not 0. */
std::optional<IC::PropertyValue> property(IC::MutableNode const& node, unsigned int id);

/** What a node answers now, as text; "(status 1)" and the like where it is not 0. */
std::string text(IC::MutableNode const& node, unsigned int id);

/** What a node holds, as text, past its own getProperty; "(unset)" where it holds nothing. */
std::string stored(IC::MutableNode const& node, unsigned int id);

#endif
