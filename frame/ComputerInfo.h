#ifndef FRAME_COMPUTERINFO_H
#define FRAME_COMPUTERINFO_H

#include <string>

namespace NQ
{

/** Facts about the machine as a whole. */
class ComputerInfo
{
public:
    /**
     * The machine's network node name, as uname reports it.
     *
     * @param name  unchanged on failure
     * @return true on success
     */
    static bool getComputerName(std::string& name);
};

} // namespace NQ

#endif
