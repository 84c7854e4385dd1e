# How a room (one folder of basis/ or host/) adds its sources, and how its tests become test programs.

# zb_files(<variable> <folder> SOURCES <files> TWINS <stems>): the paths of sources in a folder.
# A twin `x` stands for x_win.cpp on Windows and x_posix.cpp elsewhere.
function(zb_files variable folder)
  cmake_parse_arguments(ARG "" "" "SOURCES;TWINS" ${ARGN})
  set(files ${ARG_SOURCES})
  foreach(stem IN LISTS ARG_TWINS)
    if(WIN32)
      list(APPEND files ${stem}_win.cpp)
    else()
      list(APPEND files ${stem}_posix.cpp)
    endif()
  endforeach()
  list(TRANSFORM files PREPEND ${folder}/)
  set(${variable} ${files} PARENT_SCOPE)
endfunction()

# zb_room(<target> SOURCES <files> TWINS <stems> [ALONE <files>]): adds sources of the calling folder to a target. Those
# after ALONE are never compiled together with others.
function(zb_room target)
  cmake_parse_arguments(ARG "" "" "ALONE" ${ARGN})
  zb_files(files ${CMAKE_CURRENT_SOURCE_DIR} ${ARG_UNPARSED_ARGUMENTS})
  target_sources(${target} PRIVATE ${files})
  if(ARG_ALONE)
    zb_files(alone ${CMAKE_CURRENT_SOURCE_DIR} SOURCES ${ARG_ALONE})
    target_sources(${target} PRIVATE ${alone})
  endif()
  get_target_property(type ${target} TYPE)
  if(ZB_JOINED AND NOT type STREQUAL "STATIC_LIBRARY") # of which programs take only the objects that they need
    file(RELATIVE_PATH name ${PROJECT_SOURCE_DIR} ${CMAKE_CURRENT_SOURCE_DIR})
    string(MAKE_C_IDENTIFIER ${name} name)
    get_target_property(folder ${target} SOURCE_DIR)
    zb_joined(${name} MOST 8 FOLDERS ${folder} FILES ${files})
    set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
  endif()
endfunction()

# zb_precompiled(<target> [AS <target>]): has a sanitized target whose sources are compiled together also share the
# standard headers that most of them include, compiled once, or those of a target with the same options. Others do
# without: g++ then describes some variables to the debugger in another way from run to run.
function(zb_precompiled target)
  cmake_parse_arguments(ARG "" "AS" "" ${ARGN})
  if(NOT ZB_JOINED OR NOT ZB_SANITIZE)
    return()
  endif()
  if(ARG_AS)
    target_precompile_headers(${target} REUSE_FROM ${ARG_AS})
  else()
    target_precompile_headers(${target} PRIVATE <algorithm> <array> <atomic> <chrono> <cstdint> <cstdio> <cstdlib>
      <cstring> <functional> <memory> <mutex> <new> <string> <string_view> <thread> <utility> <vector>)
  endif()
endfunction()

# zb_joined(<name> MOST <n> FOLDERS <folders> FILES <files>): has targets of the given folders that join files compile
# these files together, at most n at a time. Those that include the system's headers keep to themselves.
function(zb_joined name)
  cmake_parse_arguments(ARG "" "MOST" "FOLDERS;FILES" ${ARGN})
  set(portable ${ARG_FILES})
  set(system ${ARG_FILES})
  list(FILTER portable EXCLUDE REGEX "_(posix|win)[._]")
  list(FILTER system INCLUDE REGEX "_(posix|win)[._]")
  foreach(kind IN ITEMS portable system)
    set(count 0)
    foreach(file IN LISTS ${kind})
      math(EXPR group "${count} / ${ARG_MOST}")
      math(EXPR count "${count} + 1")
      set_source_files_properties(${file} DIRECTORY ${ARG_FOLDERS} PROPERTIES UNITY_GROUP ${name}_${kind}_${group})
    endforeach()
  endforeach()
endfunction()

# zb_tests(<room> EXPORTED <files> INTERNAL <files> [LONG_RUNS <files>] [LIBRARIES <targets>] [RUNS <s>] [TIMEOUT <s>]
# [THREADED]): a room's tests.
# The EXPORTED ones use nothing but the public headers and go into exported_tests, which links the shared library. The
# INTERNAL ones make the program <room>_tests, which holds the library's objects and may see internal headers. Under a
# sanitizer, and if ZB_TESTS_BY_ROOM is on, all of them do. LONG_RUNS are those of both that run longer than they
# compile. THREADED marks a program that the thread sanitizer shall watch.
function(zb_tests room)
  cmake_parse_arguments(ARG "THREADED" "RUNS;TIMEOUT" "EXPORTED;INTERNAL;LONG_RUNS;LIBRARIES" ${ARGN})
  zb_optimised_tests(${ARG_LONG_RUNS})
  zb_joined_tests(${room}_exported ${ARG_EXPORTED})
  zb_joined_tests(${room}_internal ${ARG_INTERNAL})
  set(own_files ${ARG_INTERNAL})
  if(ZB_SANITIZE OR ZB_TESTS_BY_ROOM)
    list(APPEND own_files ${ARG_EXPORTED})
  else()
    list(TRANSFORM ARG_EXPORTED PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
    set_property(GLOBAL APPEND PROPERTY ZB_EXPORTED_TESTS ${ARG_EXPORTED})
  endif()
  add_executable(${room}_tests ${own_files})
  target_link_libraries(${room}_tests PRIVATE zb_test_support zor_basis_internal ${ARG_LIBRARIES})
  zb_warnings(${room}_tests)
  if(ARG_THREADED)
    set(threaded THREADED)
  endif()
  zb_test_program(${room}_tests RUNS ${ARG_RUNS} TIMEOUT ${ARG_TIMEOUT} ${threaded})
endfunction()

# zb_optimised_tests(<files>): excepts files of the calling folder from `zb_quickly_compiled`, unless sanitizers shorten
# them.
function(zb_optimised_tests)
  if(ARGN AND NOT MSVC AND NOT ZB_SANITIZE)
    list(TRANSFORM ARGN PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
    set_source_files_properties(${ARGN} DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR} ${PROJECT_SOURCE_DIR}/tests
      PROPERTIES COMPILE_OPTIONS -O1 SKIP_PRECOMPILE_HEADERS ON)
  endif()
endfunction()

# zb_joined_tests(<name> <files>): joins test files of the calling folder. Those for Windows stand alone, as they
# replace the same calls.
function(zb_joined_tests name)
  list(FILTER ARGN EXCLUDE REGEX "_win_test")
  list(TRANSFORM ARGN PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
  zb_joined(${name} MOST 16 FOLDERS ${CMAKE_CURRENT_SOURCE_DIR} ${PROJECT_SOURCE_DIR}/tests FILES ${ARGN})
endfunction()

# zb_quickly_compiled(<target>): optimises nothing, and in release builds describes only lines to the debugger. Tests
# take longer to compile than to run; what they test is optimised, described and sanitized in full.
function(zb_quickly_compiled target)
  if(NOT MSVC)
    target_compile_options(${target} PRIVATE -O0 $<$<CONFIG:Release>:-g1>)
  endif()
  if(ZB_SANITIZE MATCHES "undefined")
    target_compile_options(${target} PRIVATE -fno-sanitize=undefined)
  endif()
endfunction()

# zb_quickly_linked(<target>): links a program that is only tested with lld, if there is one. The linker of mingw-w64
# needs half a minute for the largest, the ordinary one several seconds for what is sanitized.
function(zb_quickly_linked target)
  if(MINGW AND ZB_QUICK_LINKER)
    set_target_properties(${target} PROPERTIES RULE_LAUNCH_LINK ${PROJECT_SOURCE_DIR}/cmake/windows/link-quickly)
  elseif(ZB_SANITIZE AND ZB_QUICK_LINKER)
    target_link_options(${target} PRIVATE -fuse-ld=lld)
  endif()
endfunction()

# zb_test_program(<target> [ARGUMENTS <words>] [RUNS <s>] [TIMEOUT <s>] [THREADED]): registers one test program, run as
# a whole. RUNS says for how long, where that is long.
function(zb_test_program target)
  cmake_parse_arguments(ARG "THREADED" "RUNS;TIMEOUT" "ARGUMENTS" ${ARGN})
  if(NOT ARG_TIMEOUT)
    set(ARG_TIMEOUT 600)
  endif()
  add_test(NAME ${target} COMMAND ${target} ${ARG_ARGUMENTS})
  # The longest runs start first, then the largest programs, so that all processors are done at about the same time.
  get_target_property(files ${target} SOURCES)
  list(LENGTH files cost)
  if(ARG_RUNS)
    math(EXPR cost "1000 + ${ARG_RUNS}")
  endif()
  set_tests_properties(${target} PROPERTIES TIMEOUT ${ARG_TIMEOUT} COST ${cost})
  if(ARG_THREADED)
    set_tests_properties(${target} PROPERTIES LABELS threads)
    add_dependencies(threaded_tests ${target})
  endif()
  if(WIN32)
    set_tests_properties(${target} PROPERTIES FIXTURES_REQUIRED wine)
  endif()
  if(ZB_SANITIZE) # with which random tests take about ten times as long
    set_tests_properties(${target} PROPERTIES ENVIRONMENT ZB_TEST_STEPS_PERCENT=20)
  endif()
  get_target_property(libraries ${target} LINK_LIBRARIES)
  if("zb_test_support" IN_LIST libraries)
    zb_quickly_compiled(${target})
    zb_quickly_linked(${target})
    if(ZB_JOINED)
      set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
      if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
        # It warns of nameless namespaces in headers, and takes joined files for headers.
        target_compile_options(${target} PRIVATE -Wno-subobject-linkage)
      endif()
      target_precompile_headers(${target} REUSE_FROM zb_test_headers)
    endif()
  endif()
endfunction()
