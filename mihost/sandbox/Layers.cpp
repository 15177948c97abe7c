#include "mihost/sandbox/Layers.h"

#include "mihost/sandbox/SystemCall.h"

#include <fcntl.h>
#include <sys/mount.h>

namespace mihost
{

Descriptor openReadOnly(std::string const& path)
{
    Descriptor view(check(open_tree(AT_FDCWD, path.c_str(), OPEN_TREE_CLONE | OPEN_TREE_CLOEXEC),
                          "cannot open " + path));
    mount_attr attributes{};
    attributes.attr_set = MOUNT_ATTR_RDONLY;
    check(mount_setattr(view.get(), "", AT_EMPTY_PATH, &attributes, sizeof attributes),
          "cannot make a view of " + path + " read-only");
    return view;
}

std::vector<Layer>& layers()
{
    static std::vector<Layer> all;
    return all;
}

} // namespace mihost
