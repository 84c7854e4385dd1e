# What holds for every target of the project: language, warnings, sanitizers, reproducible output.

# Without a build type nothing would be optimised, and nobody would notice until they measure.
get_property(zb_several_build_types GLOBAL PROPERTY GENERATOR_IS_MULTI_CONFIG)
if(PROJECT_IS_TOP_LEVEL AND NOT CMAKE_BUILD_TYPE AND NOT zb_several_build_types)
  message(STATUS "zor_basis: no build type was given, so it is RelWithDebInfo")
  set(CMAKE_BUILD_TYPE RelWithDebInfo CACHE STRING "Debug, Release, RelWithDebInfo or MinSizeRel" FORCE)
endif()

if(DEFINED BUILD_SHARED_LIBS AND NOT BUILD_SHARED_LIBS)
  message(FATAL_ERROR "zor_basis is a shared library only, because the modules of a process share its registries, and "
    "the server's platform modules replace its own at load time. Set BUILD_SHARED_LIBS to ON, or leave it undefined.")
endif()

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_C_STANDARD 11)
set(CMAKE_C_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_C_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)
set(CMAKE_INSTALL_RPATH "$ORIGIN")

# Every program and library lands in one folder, so that Windows finds the DLLs beside the programs. A parent project
# may name other folders for all.
foreach(kind IN ITEMS RUNTIME LIBRARY ARCHIVE)
  if(NOT CMAKE_${kind}_OUTPUT_DIRECTORY)
    set(CMAKE_${kind}_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)
    if(kind STREQUAL "RUNTIME")
      set(CMAKE_${kind}_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/bin)
    endif()
  endif()
endforeach()

find_package(Threads REQUIRED)

# Language and code settings of the whole build, the test framework included.
if(NOT MSVC)
  add_compile_options(-ffile-prefix-map=${PROJECT_SOURCE_DIR}=. -ffile-prefix-map=${PROJECT_BINARY_DIR}=build)
endif()
if(ZB_SANITIZE)
  add_compile_options(-fsanitize=${ZB_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${ZB_SANITIZE})
endif()
if(NOT MSVC)
  add_link_options(-Wl,--build-id=sha1)
endif()
# For g++: what the tests reach is counted, by threads too.
if(ZB_COVERAGE)
  add_compile_options(--coverage -fprofile-update=atomic)
  add_link_options(--coverage)
endif()
if(WIN32)
  add_compile_definitions(_WIN32_WINNT=0x0A00)
endif()
if(MSVC)
  add_compile_definitions(_CRT_SECURE_NO_WARNINGS) # `fopen` and its kind are meant
  add_compile_options(/utf-8)
endif()
if(MINGW)
  add_link_options(-static -Wl,--no-insert-timestamp)
endif()

# zb_warnings(<target>): the warnings that our own code is held to.
function(zb_warnings target)
  if(MSVC)
    target_compile_options(${target} PRIVATE /W4 $<$<BOOL:${ZB_WARNINGS_AS_ERRORS}>:/WX>)
  else()
    target_compile_options(${target} PRIVATE
      -Wall -Wextra -Wpedantic -Wshadow -Wcast-align
      $<$<COMPILE_LANGUAGE:CXX>:-Woverloaded-virtual>
      $<$<COMPILE_LANGUAGE:CXX>:-Wzero-as-null-pointer-constant>
      # `WBStr` has virtual functions and is never deleted by another type; clang says so of every container of them.
      $<$<AND:$<COMPILE_LANGUAGE:CXX>,$<CXX_COMPILER_ID:Clang>>:-Wno-delete-non-abstract-non-virtual-dtor>
      $<$<BOOL:${ZB_WARNINGS_AS_ERRORS}>:-Werror>)
  endif()
endfunction()
