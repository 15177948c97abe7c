# `cpack` makes an RPM of each component, for Fedora or for openSUSE. script/package configures the
# build as the family lays files out, builds it and calls cpack. Debian's own tools make its packages;
# descriptions in debian/control apply to the RPMs, too.

# Packages are made of a whole build.
if(NOT MI_PROGRAM)
    return()
endif()

set(MI_RPM_FAMILY fedora CACHE STRING "Whose RPMs cpack makes: fedora or opensuse")

set(CPACK_GENERATOR RPM)
set(CPACK_PACKAGE_NAME mihost)
string(REPLACE - ~ CPACK_PACKAGE_VERSION ${MI_VERSION})
set(CPACK_PACKAGE_VENDOR "The maintainers <maintainers@example.org>")
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_COMPONENTS_GROUPING IGNORE)
set(CPACK_RPM_COMPONENT_INSTALL ON)
set(CPACK_RPM_MAIN_COMPONENT mihost)
set(CPACK_RPM_FILE_NAME RPM-DEFAULT)
set(CPACK_RPM_PACKAGE_GROUP System/Management)
set(CPACK_RPM_PACKAGE_RELEASE 1)
set(CPACK_RPM_PACKAGE_RELEASE_DIST ON)
# No licence of the project's own has been chosen; the others are of what is compiled into mihost.
set(CPACK_RPM_PACKAGE_LICENSE "LicenseRef-All-Rights-Reserved AND BSD-3-Clause AND MIT")

# Directories that other packages own.
set(CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION
    ${CMAKE_INSTALL_LIBDIR}/cmake ${CMAKE_INSTALL_LIBDIR}/pkgconfig ${CMAKE_INSTALL_LIBEXECDIR}
    lib/systemd lib/systemd/system
    share/ansible share/ansible/collections share/ansible/collections/ansible_collections
    share/bash-completion share/bash-completion/completions share/cockpit share/doc/packages
    share/fish share/fish/vendor_completions.d share/licenses
    share/man share/man/man1 share/man/man7 share/man/man8 share/zsh share/zsh/site-functions)
list(TRANSFORM CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION PREPEND ${CMAKE_INSTALL_PREFIX}/)

# mi_rpm_name(COMPONENT NAME): libfoo-dev is libfoo-devel, and Fedora's libfoo1 is libfoo.
function(mi_rpm_name component name)
    string(REGEX REPLACE "-dev$" "-devel" result ${component})
    if(MI_RPM_FAMILY STREQUAL fedora)
        string(REGEX REPLACE "^(lib.*)[0-9]$" "\\1" result ${result})
    endif()
    set(${name} ${result} PARENT_SCOPE)
endfunction()

# What packages require besides each other and the libraries that rpm finds.
set(requires_libzorvvxicosswmi1 kmod shadow-utils)
if(MI_RPM_FAMILY STREQUAL opensuse)
    set(requires_libzorvvxicosswmi1 kmod shadow)
endif()
set(requires_ansible-collection-mi-host "ansible-core >= 2.14")
set(requires_cockpit-mihost "cockpit-bridge >= 287" mihost)
set(requires_mihost-prometheus systemd)

file(READ debian/control control)
string(REPLACE ";" "\\;" control "${control}")
string(REGEX MATCHALL "Package: [^\n]+\n([^\n]+\n)+" stanzas "${control}")
set(CPACK_COMPONENTS_ALL "")
foreach(stanza IN LISTS stanzas)
    string(REGEX MATCH "Package: ([^\n]+)" ignored "${stanza}")
    set(component ${CMAKE_MATCH_1})
    if(component STREQUAL cockpit-mihost AND NOT MI_COCKPIT)
        continue()
    endif()
    list(APPEND CPACK_COMPONENTS_ALL ${component})
    set(package CPACK_RPM_${component}_PACKAGE)
    mi_rpm_name(${component} ${package}_NAME)

    string(REGEX MATCH "\nDescription: (.)([^\n]*)\n(.*)$" ignored "${stanza}")
    set(description "\n${CMAKE_MATCH_3}")
    string(TOUPPER "${CMAKE_MATCH_1}" capital)
    set(${package}_SUMMARY "${capital}${CMAKE_MATCH_2}")
    string(REPLACE "\n " "\n" description "${description}")
    string(REPLACE "\n.\n" "\n\n" description "${description}")
    string(STRIP "${description}" ${package}_DESCRIPTION)

    set(requires ${requires_${component}})
    string(REGEX MATCH "\nDepends:[^\n]*(\n [^\n]+)*" depends "${stanza}")
    string(REGEX MATCHALL "[a-z0-9-]+ [(]= " own "${depends}")
    foreach(dependency IN LISTS own)
        string(REGEX REPLACE " .*" "" dependency ${dependency})
        mi_rpm_name(${dependency} name)
        list(APPEND requires "${name} = ${CPACK_PACKAGE_VERSION}-${CPACK_RPM_PACKAGE_RELEASE}%{?dist}")
    endforeach()
    if(requires)
        list(JOIN requires ", " ${package}_REQUIRES)
    endif()

    if(stanza MATCHES "\nArchitecture: all\n")
        set(${package}_ARCHITECTURE noarch)
    elseif(MI_RPM_FAMILY STREQUAL opensuse AND component MATCHES "^lib.*[0-9]$")
        # Fedora's C library does this for all packages.
        foreach(time IN ITEMS POST_INSTALL POST_UNINSTALL)
            set(CPACK_RPM_${component}_${time}_SCRIPT_FILE ${CMAKE_CURRENT_LIST_DIR}/rpm/ldconfig)
        endforeach()
    endif()
endforeach()

set(units ${CMAKE_CURRENT_LIST_DIR}/rpm/units)
set(CPACK_RPM_mihost-prometheus_POST_INSTALL_SCRIPT_FILE ${units}-post)
set(CPACK_RPM_mihost-prometheus_PRE_UNINSTALL_SCRIPT_FILE ${units}-preun)
set(CPACK_RPM_mihost-prometheus_POST_UNINSTALL_SCRIPT_FILE ${units}-postun)

include(CPack)
