# How a shared library of this project is made: version, export list, and on Windows the version resource and the pin.

if(WIN32)
  enable_language(RC)
endif()

option(ZB_SPLIT_DEBUG_SYMBOLS "Keep debug symbols in a file beside each library" OFF)

# The folder of include/zor_basis that a component of find_package names; all of them are the one library.
set(ZB_COMPONENTS text containers memory sync files store walk timers log system crypto flat)

# zb_shared_library(<target> IMAGE_BASE <address> DESCRIPTION <text>): settings common to all our shared libraries.
# The exported names are those that carry an export macro in their headers; with mingw-w64 those of
# cmake/exports/<target>.def, on ELF only those that the version script cmake/exports/<target>.map lets through.
function(zb_shared_library target)
  cmake_parse_arguments(ARG "" "IMAGE_BASE;DESCRIPTION" "" ${ARGN})
  add_library(zor_basis::${target} ALIAS ${target})
  set(exports ${PROJECT_SOURCE_DIR}/cmake/exports/${target})
  if(WIN32)
    set(ZB_RC_NAME ${target})
    set(ZB_RC_DESCRIPTION "${ARG_DESCRIPTION}")
    configure_file(${PROJECT_SOURCE_DIR}/cmake/windows/version.rc.in ${CMAKE_CURRENT_BINARY_DIR}/${target}.rc @ONLY)
    target_sources(${target} PRIVATE ${CMAKE_CURRENT_BINARY_DIR}/${target}.rc
      ${PROJECT_SOURCE_DIR}/cmake/windows/pin_module.cpp)
    set_target_properties(${target} PROPERTIES PREFIX "")
    if(MINGW) # the list contains names as only its compiler writes them
      target_sources(${target} PRIVATE ${exports}.def)
      set_target_properties(${target} PROPERTIES LINK_DEPENDS ${exports}.def)
      target_link_options(${target} PRIVATE -Wl,--image-base=${ARG_IMAGE_BASE})
    endif()
  else()
    # Threads go on in it when its last user has unloaded it; on Windows it pins itself.
    target_link_options(${target} PRIVATE -Wl,--version-script=${exports}.map -Wl,-z,nodelete)
    if(NOT ZB_SANITIZE) # a sanitizer's functions are in the program
      target_link_options(${target} PRIVATE -Wl,--no-undefined)
    endif()
    set_target_properties(${target} PROPERTIES LINK_DEPENDS ${exports}.map)
  endif()
  zb_split_symbols(${target})
endfunction()

# zb_split_symbols(<target>): with ZB_SPLIT_DEBUG_SYMBOLS, moves what the debugger reads into <file>.debug beside the
# file. Build id and debug link lead the debugger there.
function(zb_split_symbols target)
  if(ZB_SPLIT_DEBUG_SYMBOLS)
    # -p: objcopy otherwise puts the present time into a PE file.
    add_custom_command(TARGET ${target} POST_BUILD
      COMMAND ${CMAKE_OBJCOPY} -p --only-keep-debug $<TARGET_FILE:${target}> $<TARGET_FILE:${target}>.debug
      COMMAND ${CMAKE_OBJCOPY} -p --strip-debug --add-gnu-debuglink=$<TARGET_FILE_NAME:${target}>.debug
              $<TARGET_FILE:${target}>
      WORKING_DIRECTORY $<TARGET_FILE_DIR:${target}> VERBATIM)
  endif()
endfunction()
