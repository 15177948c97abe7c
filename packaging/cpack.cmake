# `cpack` makes a .deb of what `cmake --install` puts in place. script/package configures the build
# as Debian lays files out, builds it and calls cpack.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME mihost)
set(CPACK_PACKAGE_CONTACT "The maintainers <maintainers@example.org>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "management interface for Linux and its reference host")
set(CPACK_PACKAGE_DESCRIPTION "\
A plug-in for host management agents: loaded into one, it shows the operating
system as a tree of nodes with numbered properties (facts, kernel modules,
local users and groups, the newest lines of the system log) and administers
accounts.
.
The package holds the plug-in, libzorvvxicosswmi.so.1; mihost, a program that
loads it, shows and drives its tree; the runtime and the accelerator that
mihost brings for it; and the headers for writing a host of one's own.")
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_PRE_BUILD_SCRIPTS ${CMAKE_CURRENT_LIST_DIR}/debian/finish.cmake)

set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
# The tools that the plug-in runs; and what the other half of the package is of use with.
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "kmod, passwd")
set(CPACK_DEBIAN_PACKAGE_SUGGESTS "g++, openssh-client, pkg-config, rsyslog")
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)

include(CPack)
