# How a room (one folder of basis/ or host/) adds its sources, and how its tests become test programs.

# zb_room(<target> SOURCES <files> TWINS <stems>): adds sources of the calling folder to a target.
# A twin `x` stands for x_win.cpp on Windows and x_posix.cpp elsewhere.
function(zb_room target)
  cmake_parse_arguments(ARG "" "" "SOURCES;TWINS" ${ARGN})
  set(files ${ARG_SOURCES})
  foreach(stem IN LISTS ARG_TWINS)
    if(WIN32)
      list(APPEND files ${stem}_win.cpp)
    else()
      list(APPEND files ${stem}_posix.cpp)
    endif()
  endforeach()
  list(TRANSFORM files PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
  target_sources(${target} PRIVATE ${files})
endfunction()

# zb_tests(<room> EXPORTED <files> INTERNAL <files> [LIBRARIES <targets>] [TIMEOUT <s>] [THREADED]): a room's tests.
# All files make the program <room>_tests, which holds the library's objects and may see internal headers. The EXPORTED
# ones also go into exported_tests, which uses nothing but the public headers and the shared library. THREADED marks a
# program that the thread sanitizer shall watch.
function(zb_tests room)
  cmake_parse_arguments(ARG "THREADED" "TIMEOUT" "EXPORTED;INTERNAL;LIBRARIES" ${ARGN})
  add_executable(${room}_tests ${ARG_EXPORTED} ${ARG_INTERNAL})
  target_link_libraries(${room}_tests PRIVATE zb_test_support zor_basis_internal ${ARG_LIBRARIES})
  zb_warnings(${room}_tests)
  if(ARG_THREADED)
    set(threaded THREADED)
  endif()
  zb_test_program(${room}_tests TIMEOUT ${ARG_TIMEOUT} ${threaded})
  list(TRANSFORM ARG_EXPORTED PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
  set_property(GLOBAL APPEND PROPERTY ZB_EXPORTED_TESTS ${ARG_EXPORTED})
endfunction()

# zb_quickly_compiled(<target>): optimises nothing. Tests take longer to compile than to run; what they test is optimised.
function(zb_quickly_compiled target)
  if(NOT MSVC)
    target_compile_options(${target} PRIVATE -O0)
  endif()
endfunction()

# zb_test_program(<target> [ARGUMENTS <words>] [TIMEOUT <s>] [THREADED]): registers one test program, run as a whole.
function(zb_test_program target)
  cmake_parse_arguments(ARG "THREADED" "TIMEOUT" "ARGUMENTS" ${ARGN})
  if(NOT ARG_TIMEOUT)
    set(ARG_TIMEOUT 600)
  endif()
  add_test(NAME ${target} COMMAND ${target} ${ARG_ARGUMENTS})
  set_tests_properties(${target} PROPERTIES TIMEOUT ${ARG_TIMEOUT})
  if(ARG_THREADED)
    set_tests_properties(${target} PROPERTIES LABELS threads)
    add_dependencies(threaded_tests ${target})
  endif()
  if(WIN32)
    set_tests_properties(${target} PROPERTIES FIXTURES_REQUIRED wine)
  endif()
  get_target_property(libraries ${target} LINK_LIBRARIES)
  if("zb_test_support" IN_LIST libraries)
    zb_quickly_compiled(${target})
    if(ZB_PRECOMPILED_TESTS)
      target_precompile_headers(${target} REUSE_FROM zb_test_headers)
    endif()
  endif()
endfunction()
