#ifndef MIHOST_CLI_PLUGIN_PLUGIN_H
#define MIHOST_CLI_PLUGIN_PLUGIN_H

#include "host/ManagementInterface.h"

#include <string>

namespace mihost
{

/** The named plug-in file, or the one next to this program, or its plain name. */
std::string pluginFile(std::string const& named);

/** A loaded plug-in. The destructor unloads the plug-in if it was started, then the library. */
class Plugin
{
public:
    /**
     * Loads the library and gets its interface.
     *
     * @param file  a path, or a plain name for the loader to look up
     * @throws Failure with the file and the reason
     */
    explicit Plugin(std::string const& file);
    ~Plugin();
    Plugin(Plugin const&) = delete;
    Plugin& operator=(Plugin const&) = delete;

    /** Builds the tree. @throws Failure if the plug-in fails */
    void start();

    bool started() const
    {
        return started_;
    }
    IC::ManagementInterface& interface()
    {
        return *interface_;
    }

    /** The status object from OpenMI; may be null. */
    IC::Error const* status() const
    {
        return status_;
    }

    /** The file that was loaded, as an absolute path. */
    std::string path() const;

    /** The library's SONAME, empty if it has none. */
    std::string soname() const;

private:
    void* library_;
    IC::ManagementInterface* interface_ = nullptr;
    IC::Error* status_ = nullptr; // what it comes to hold, initialize returns
    bool started_ = false;
};

} // namespace mihost

#endif
