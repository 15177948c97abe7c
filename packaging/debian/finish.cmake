# Run by cpack between installing and packing: adds the files that only a Debian package holds, and
# works out what its control files say. cpack could ask for the latter itself, but would then call
# ldconfig from maintainer scripts.

set(usr ${CPACK_TEMPORARY_DIRECTORY}${CPACK_PACKAGING_INSTALL_PREFIX})
set(doc ${usr}/share/doc/${CPACK_PACKAGE_NAME})
set(scratch ${CPACK_TOPLEVEL_DIRECTORY})
set(control ${scratch}/debian)

# run(OUTPUT COMMAND...)
function(run output)
    execute_process(COMMAND ${ARGN} WORKING_DIRECTORY ${scratch} COMMAND_ERROR_IS_FATAL ANY
        OUTPUT_VARIABLE text OUTPUT_STRIP_TRAILING_WHITESPACE ERROR_QUIET)
    set(${output} "${text}" PARENT_SCOPE)
endfunction()

# A new version needs an entry of its own.
file(STRINGS ${CMAKE_CURRENT_LIST_DIR}/changelog newest LIMIT_COUNT 1)
set(version ${CPACK_PACKAGE_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE})
string(FIND "${newest}" "${CPACK_PACKAGE_NAME} (${version}) " at)
if(NOT at EQUAL 0)
    message(FATAL_ERROR "packaging/debian/changelog begins with '${newest}', not with ${version}")
endif()

configure_file(${CMAKE_CURRENT_LIST_DIR}/changelog ${doc}/changelog.Debian COPYONLY)
configure_file(${CMAKE_CURRENT_LIST_DIR}/../../CHANGELOG.md ${doc}/changelog COPYONLY)
configure_file(${CMAKE_CURRENT_LIST_DIR}/copyright ${doc}/copyright COPYONLY)
configure_file(${CMAKE_CURRENT_LIST_DIR}/lintian-overrides
    ${usr}/share/lintian/overrides/${CPACK_PACKAGE_NAME} COPYONLY)
file(GLOB pages ${usr}/share/man/man*/*)
run(ignored gzip -9n ${doc}/changelog.Debian ${doc}/changelog ${pages})

file(GLOB programs ${usr}/bin/*)
file(GLOB_RECURSE libraries ${usr}/lib/*.so.*)
set(shlibs "")
set(library_dirs "")
foreach(library IN LISTS libraries)
    cmake_path(GET library PARENT_PATH dir)
    list(APPEND library_dirs -l${dir})
    run(dynamic readelf --dynamic ${library})
    if(NOT dynamic MATCHES "soname: \\[([^]]+)\\.so\\.([^]]+)\\]")
        message(FATAL_ERROR "${library} has no versioned soname")
    endif()
    list(APPEND shlibs
        "${CMAKE_MATCH_1} ${CMAKE_MATCH_2} ${CPACK_PACKAGE_NAME} (>= ${CPACK_PACKAGE_VERSION})\n")
endforeach()
list(REMOVE_DUPLICATES shlibs)
list(REMOVE_DUPLICATES library_dirs)

file(WRITE ${control}/triggers "activate-noawait ldconfig\n")
file(WRITE ${control}/shlibs ${shlibs})
list(APPEND CPACK_DEBIAN_PACKAGE_CONTROL_EXTRA ${control}/triggers ${control}/shlibs)

file(WRITE ${control}/control "") # dpkg-shlibdeps insists on one
run(depends dpkg-shlibdeps --ignore-missing-info ${library_dirs} -O ${programs} ${libraries})
string(REPLACE "shlibs:Depends=" "" CPACK_DEBIAN_PACKAGE_DEPENDS "${depends}")
