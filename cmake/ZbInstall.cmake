# The installed package: libraries, public headers, split debug symbols, and what find_package(zor_basis) reads.

include(CMakePackageConfigHelpers)

set(zb_package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/zor_basis)
set(zb_libraries zor_basis xos_basics xos_url hq_basis)

install(TARGETS ${zb_libraries} EXPORT zor_basis
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR})
if(MINGW)
  # With -static the linker takes -lNAME from libNAME.a alone, and an import library serves as one.
  foreach(library IN LISTS zb_libraries)
    install(FILES $<TARGET_LINKER_FILE:${library}> DESTINATION ${CMAKE_INSTALL_LIBDIR} RENAME lib${library}.a)
  endforeach()
endif()
install(EXPORT zor_basis NAMESPACE zor_basis:: DESTINATION ${zb_package_dir})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_SOURCE_DIR}/host/include/xos_host.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})

configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/zor_basisConfig.cmake.in
  ${PROJECT_BINARY_DIR}/zor_basisConfig.cmake INSTALL_DESTINATION ${zb_package_dir})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/zor_basisConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/zor_basisConfig.cmake ${PROJECT_BINARY_DIR}/zor_basisConfigVersion.cmake
  DESTINATION ${zb_package_dir})

if(ZB_SPLIT_DEBUG_SYMBOLS)
  foreach(library IN LISTS zb_libraries)
    install(FILES $<TARGET_FILE:${library}>.debug DESTINATION
      $<IF:$<PLATFORM_ID:Windows>,${CMAKE_INSTALL_BINDIR},${CMAKE_INSTALL_LIBDIR}>)
  endforeach()
endif()
