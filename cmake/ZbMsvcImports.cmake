# NAME.lib: import libraries for MSVC's linker. They hold the plain functions only; C++ names differ between compilers.

find_program(ZB_LLVM_DLLTOOL NAMES llvm-dlltool llvm-dlltool-19 llvm-dlltool-14)
if(NOT ZB_LLVM_DLLTOOL)
  message(STATUS "zor_basis: no import libraries for MSVC, as llvm-dlltool (package llvm) is missing")
  return()
endif()

foreach(library IN LISTS zb_libraries)
  set(list ${PROJECT_SOURCE_DIR}/cmake/exports/${library}.def)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${list})
  file(STRINGS ${list} lines REGEX "^ +[a-zA-Z]")
  if(lines)
    list(JOIN lines "\n" lines)
    set(plain ${PROJECT_BINARY_DIR}/msvc/${library})
    file(CONFIGURE OUTPUT ${plain}.def CONTENT "LIBRARY ${library}.dll\nEXPORTS\n@lines@\n" @ONLY)
    add_custom_command(OUTPUT ${plain}.lib DEPENDS ${plain}.def VERBATIM
      COMMAND ${ZB_LLVM_DLLTOOL} -m i386:x86-64 -d ${plain}.def -l ${plain}.lib)
    list(APPEND msvc_imports ${plain}.lib)
  endif()
endforeach()
add_custom_target(msvc_imports ALL DEPENDS ${msvc_imports})
install(FILES ${msvc_imports} DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development)
