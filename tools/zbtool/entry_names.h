/// \file
/// What the two systems make of the names of entries. entry_names_posix.cpp, entry_names_win.cpp.

#ifndef TOOLS_ZBTOOL_ENTRY_NAMES_H
#define TOOLS_ZBTOOL_ENTRY_NAMES_H

#include <string>
#include <string_view>

namespace zbtool {

/// The path without the slashes at its end: Windows finds nothing at "folder/".
std::string withoutEndSlashes(std::string path);

/// \return why the library cannot reach an entry by this path; empty if it can
std::string_view whyUnreachable(std::string_view path);

/// The form in which the system compares names: two names with one form are one entry of a folder.
std::string comparedName(std::string name);

} // namespace zbtool

#endif
