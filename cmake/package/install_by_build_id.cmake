# Installs PROGRAM.debug as lib/debug/.build-id/AB/CDEF.debug, where the debugger finds it by the build id ABCDEF of
# PROGRAM.
execute_process(COMMAND ${READELF} -n ${PROGRAM} OUTPUT_VARIABLE notes COMMAND_ERROR_IS_FATAL ANY)
if(NOT notes MATCHES "Build ID: ([0-9a-f][0-9a-f])([0-9a-f]+)")
  message(FATAL_ERROR "${PROGRAM} has no build id")
endif()
set(name ${CMAKE_MATCH_2}.debug)
file(INSTALL ${PROGRAM}.debug DESTINATION ${CMAKE_INSTALL_PREFIX}/lib/debug/.build-id/${CMAKE_MATCH_1} RENAME ${name})
