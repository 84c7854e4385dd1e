# The Debian packages: one for each component, with what Debian's policy asks of it.

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_DEBIAN_PACKAGE_SOURCE zor-basis)
set(CPACK_DEBIAN_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

# zb_debian_package(<component> <package> SECTION <section> [DEPENDS <packages>] DESCRIPTION <text>)
function(zb_debian_package component package)
  cmake_parse_arguments(ARG "" "SECTION;DEPENDS;DESCRIPTION" "" ${ARGN})
  string(TOUPPER ${component} name)
  set(CPACK_DEBIAN_${name}_PACKAGE_NAME ${package} PARENT_SCOPE)
  set(CPACK_DEBIAN_${name}_PACKAGE_SECTION ${ARG_SECTION} PARENT_SCOPE)
  set(CPACK_DEBIAN_${name}_PACKAGE_DEPENDS "${ARG_DEPENDS}" PARENT_SCOPE)
  set(CPACK_COMPONENT_${name}_DESCRIPTION "${ARG_DESCRIPTION}" PARENT_SCOPE)
  if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
    install(FILES ${PROJECT_SOURCE_DIR}/cmake/package/copyright ${PROJECT_BINARY_DIR}/changelog.Debian.gz
      DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${package} COMPONENT ${component})
  endif()
endfunction()

set(zb_library libzor-basis${PROJECT_VERSION_MAJOR})
set(zb_same_version "${PROJECT_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE}")
# libcurl is loaded by name when it is first needed, so dpkg-shlibdeps does not see it.
zb_debian_package(library ${zb_library} SECTION libs DEPENDS "libcurl4 (>= 7.85) | libcurl4t64"
  DESCRIPTION "Strings with inline buffers, wide text, containers, paths, files, tree walks,
timers, locks, a job queue, logs, processes and cryptography, and the
stand-alone platform layer that they run on without a print server.")
zb_debian_package(development libzor-basis-dev SECTION libdevel DEPENDS "${zb_library} (= ${zb_same_version})"
  DESCRIPTION "Headers, and what find_package and pkg-config read.")
zb_debian_package(tools zor-basis-tools SECTION utils DEPENDS "${zb_library} (= ${zb_same_version})"
  DESCRIPTION "zbtool works with files and trees, dictionaries, timer reports, logs and
secrets; zor_basis_demo copies a folder of jobs, verifies the copy and
prints a report of timers.")
zb_debian_package(symbols ${zb_library}-dbgsym SECTION debug DEPENDS "${zb_library} (= ${zb_same_version})"
  DESCRIPTION "Symbols for the debugger, which finds them by build id.")
zb_debian_package(documentation libzor-basis-doc SECTION doc
  DESCRIPTION "A guide that begins with a first hour, the glossary, reasons of failures,
decisions, behaviour that must stay, and the sources of the examples.")
set(CPACK_DEBIAN_DOCUMENTATION_PACKAGE_ARCHITECTURE all)
set(CPACK_DEBIAN_SYMBOLS_PACKAGE_SHLIBDEPS OFF)

foreach(component IN ITEMS LIBRARY TOOLS)
  set(CPACK_DEBIAN_${component}_PACKAGE_SHLIBDEPS ON)
endforeach()
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_LIBRARY_OUTPUT_DIRECTORY})

# What packages that link the library depend on: the same minor version, as in find_package.
math(EXPR zb_next_minor "${PROJECT_VERSION_MINOR} + 1")
set(zb_minor ${PROJECT_VERSION_MAJOR}.${PROJECT_VERSION_MINOR})
set(zb_next ${PROJECT_VERSION_MAJOR}.${zb_next_minor})
file(CONFIGURE OUTPUT ${PROJECT_BINARY_DIR}/shlibs @ONLY CONTENT
"libzor_basis ${PROJECT_VERSION_MAJOR} ${zb_library} (>= ${zb_minor}), ${zb_library} (<< ${zb_next}~)
")
set(CPACK_DEBIAN_LIBRARY_PACKAGE_CONTROL_EXTRA
  ${PROJECT_BINARY_DIR}/shlibs ${PROJECT_SOURCE_DIR}/cmake/package/triggers)

# The changelog of the packages, in Debian's form.
string(TIMESTAMP zb_date "%a, %d %b %Y %H:%M:%S +0000" UTC)
file(CONFIGURE OUTPUT ${PROJECT_BINARY_DIR}/changelog.Debian @ONLY CONTENT
"zor-basis (${zb_same_version}) unstable; urgency=medium

  * Version ${PROJECT_VERSION}; libzor-basis-doc has what changed for users.

 -- ${ZB_MAINTAINER}  ${zb_date}
")
execute_process(COMMAND gzip -9nf ${PROJECT_BINARY_DIR}/changelog.Debian COMMAND_ERROR_IS_FATAL ANY)
