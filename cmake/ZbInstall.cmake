# What is installed, by component: library, development (headers, links, and what find_package and pkg-config read),
# tools, symbols, documentation.

include(CMakePackageConfigHelpers)

set(zb_package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/zor_basis)
set(zb_libraries zor_basis xos_basics xos_url hq_basis)

install(TARGETS ${zb_libraries} EXPORT zor_basis
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT library
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library NAMELINK_COMPONENT development
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development)
if(MINGW)
  # With -static the linker takes -lNAME from libNAME.a alone, and an import library serves as one.
  foreach(library IN LISTS zb_libraries)
    install(FILES $<TARGET_LINKER_FILE:${library}> DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development
      RENAME lib${library}.a)
  endforeach()
  include(ZbMsvcImports)
endif()
install(EXPORT zor_basis NAMESPACE zor_basis:: DESTINATION ${zb_package_dir} COMPONENT development)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development
  FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_SOURCE_DIR}/host/include/xos_host.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  COMPONENT development)

# find_package. Before version 1.0 a new minor version may break what was built for an older one.
set(zb_compatible SameMajorVersion)
if(PROJECT_VERSION_MAJOR EQUAL 0)
  set(zb_compatible SameMinorVersion)
endif()
list(JOIN ZB_COMPONENTS " " ZB_COMPONENTS)
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/zor_basisConfig.cmake.in
  ${PROJECT_BINARY_DIR}/zor_basisConfig.cmake INSTALL_DESTINATION ${zb_package_dir}
  NO_SET_AND_CHECK_MACRO NO_CHECK_REQUIRED_COMPONENTS_MACRO)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/zor_basisConfigVersion.cmake COMPATIBILITY ${zb_compatible})
install(FILES ${PROJECT_BINARY_DIR}/zor_basisConfig.cmake ${PROJECT_BINARY_DIR}/zor_basisConfigVersion.cmake
  DESTINATION ${zb_package_dir} COMPONENT development)

# pkg-config. Its files find the prefix from their own place, so that the prefix may be moved.
file(RELATIVE_PATH ZB_PC_PREFIX ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig ${CMAKE_INSTALL_PREFIX})
string(REGEX REPLACE "/$" "" ZB_PC_PREFIX "${ZB_PC_PREFIX}")
foreach(file IN ITEMS zor_basis.pc xos_host.pc)
  configure_file(${PROJECT_SOURCE_DIR}/cmake/package/${file}.in ${PROJECT_BINARY_DIR}/${file} @ONLY)
  install(FILES ${PROJECT_BINARY_DIR}/${file} DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)
endforeach()

set(zb_programs ${zb_libraries})
foreach(tool IN ITEMS zbtool zor_basis_demo)
  if(NOT TARGET ${tool})
    continue()
  endif()
  if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
    set_target_properties(${tool} PROPERTIES INSTALL_RPATH "") # the loader knows the system's libraries
  else()
    set_target_properties(${tool} PROPERTIES INSTALL_RPATH "$ORIGIN/../${CMAKE_INSTALL_LIBDIR}")
  endif()
  install(TARGETS ${tool} RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT tools)
  list(APPEND zb_programs ${tool})
endforeach()
if(TARGET zbtool_man)
  install(DIRECTORY ${PROJECT_BINARY_DIR}/man/ DESTINATION ${CMAKE_INSTALL_MANDIR}/man1 COMPONENT tools
    FILES_MATCHING PATTERN "*.gz")
  install(FILES ${PROJECT_SOURCE_DIR}/tools/zbtool/zbtool.bash COMPONENT tools RENAME zbtool
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/bash-completion/completions)
endif()

# Symbols lie where the debugger looks for them: those of the system below /usr/lib/debug by build id, others beside
# the file.
if(ZB_SPLIT_DEBUG_SYMBOLS)
  foreach(program IN LISTS zb_programs)
    get_target_property(type ${program} TYPE)
    set(folder ${CMAKE_INSTALL_BINDIR})
    if(NOT WIN32 AND type STREQUAL "SHARED_LIBRARY")
      set(folder ${CMAKE_INSTALL_LIBDIR})
    endif()
    if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
      install(CODE "
        set(READELF \"${CMAKE_READELF}\")
        set(PROGRAM \"$<TARGET_FILE:${program}>\")
        include(\"${PROJECT_SOURCE_DIR}/cmake/package/install_by_build_id.cmake\")" COMPONENT symbols)
    else()
      install(FILES $<TARGET_FILE:${program}>.debug DESTINATION ${folder} COMPONENT symbols)
    endif()
  endforeach()
endif()

# How debuggers show values: gdb looks for printers beside the library, and for those of the system's libraries below
# its own folder; Visual Studio takes the other file from the project that is debugged.
set(zb_printers $<TARGET_FILE_NAME:zor_basis>-gdb.py)
if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
  set(zb_printers_dir ${CMAKE_INSTALL_DATAROOTDIR}/gdb/auto-load${CMAKE_INSTALL_FULL_LIBDIR})
elseif(WIN32)
  set(zb_printers_dir ${CMAKE_INSTALL_BINDIR})
else()
  set(zb_printers_dir ${CMAKE_INSTALL_LIBDIR})
endif()
install(FILES ${PROJECT_SOURCE_DIR}/tools/debuggers/zor_basis_printers.py DESTINATION ${zb_printers_dir}
  COMPONENT library RENAME ${zb_printers})
install(FILES ${PROJECT_SOURCE_DIR}/tools/debuggers/zor_basis.natvis DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/zor_basis
  COMPONENT development)

set(zb_doc_dir ${CMAKE_INSTALL_DATAROOTDIR}/doc/libzor-basis-doc)
install(FILES ${PROJECT_SOURCE_DIR}/README.md ${PROJECT_SOURCE_DIR}/CHANGELOG.md ${PROJECT_SOURCE_DIR}/CONTRIBUTING.md
  DESTINATION ${zb_doc_dir} COMPONENT documentation)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/docs ${PROJECT_SOURCE_DIR}/examples
  DESTINATION ${zb_doc_dir} COMPONENT documentation PATTERN CMakeLists.txt EXCLUDE PATTERN doxygen EXCLUDE)
