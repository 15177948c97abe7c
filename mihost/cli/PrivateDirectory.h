#ifndef MIHOST_CLI_PRIVATEDIRECTORY_H
#define MIHOST_CLI_PRIVATEDIRECTORY_H

#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/**
 * A working directory that nobody else can look into, since the plug-in writes a password hash to a
 * file where it stands. Going away, it takes its contents with it and goes back where it came from.
 */
class PrivateDirectory
{
public:
    /** @throws Failure where it cannot be made */
    PrivateDirectory();
    ~PrivateDirectory();
    PrivateDirectory(PrivateDirectory const&) = delete;
    PrivateDirectory& operator=(PrivateDirectory const&) = delete;

    std::string const& path() const
    {
        return path_;
    }

private:
    std::string path_;
    Descriptor previous_;
};

} // namespace mihost

#endif
