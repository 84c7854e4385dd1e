# What `cpack` makes of the installed components: Debian packages on Linux, a zip file for Windows. With
# SOURCE_DATE_EPOCH in the environment, now and when cpack runs, the same source gives the same bytes.

set(ZB_MAINTAINER "zor_basis maintainers <maintainers@users.noreply.c-seed-a6345736.example>" CACHE STRING
  "Whom the packages name as their maintainer")

set(CPACK_PACKAGE_NAME zor-basis)
set(CPACK_PACKAGE_VENDOR "zor_basis maintainers")
set(CPACK_PACKAGE_CONTACT ${ZB_MAINTAINER})
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "Foundation library of a print server's page-description component")
set(CPACK_PACKAGE_DIRECTORY ${PROJECT_BINARY_DIR}/packages)
set(CPACK_COMPONENTS_ALL library development tools symbols documentation)
set(CPACK_VERBATIM_VARIABLES ON)
set(CPACK_THREADS 1) # several would compress into other bytes
set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/cmake/package/one_time.cmake)

if(WIN32)
  set(CPACK_GENERATOR ZIP)
  set(CPACK_PACKAGE_FILE_NAME zor_basis-${PROJECT_VERSION}-windows-x64)
  set(CPACK_INCLUDE_TOPLEVEL_DIRECTORY ON)
else()
  set(CPACK_GENERATOR DEB)
  include(ZbDebian)
endif()
include(CPack)
