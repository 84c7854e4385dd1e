/// \file
/// The files that a fetch reads and writes. Twins: url_files_posix.cpp, url_files_win.cpp; what both do in the same way
/// is in url_files.cpp.

#ifndef HOST_XOS_URL_URL_FILES_H
#define HOST_XOS_URL_URL_FILES_H

#include "host/xos_url/url_text.h"

#include <cstdio>
#include <string>

namespace host {

/// A path as the system spells it; both slash kinds are accepted.
std::string systemPath(std::string path);

/// The system's path of a `file:` URL; empty when it cannot be reached from here.
std::string pathOfFileUrl(FileUrl const& url);

/// Makes a file that was not there.
/// \return null when there is one, or it cannot be made
std::FILE* createNewFile(std::string const& path);

/// Opens a regular file for reading.
/// \return null for anything else
std::FILE* openRegularFile(std::string const& path);

/// The descriptor of a file that was not there.
/// \return -1 when there is one, or it cannot be made
int newDescriptor(std::string const& path);

/// The descriptor of a regular file, for reading.
/// \return -1 for anything else
int regularDescriptor(std::string const& path);

/// \return null without memory; the descriptor is then still open
std::FILE* descriptorStream(int descriptor, char const* mode);

void closeDescriptor(int descriptor);

/// Puts a file in the place of another in one step. A directory is not replaced.
bool replaceFile(std::string const& from, std::string const& to);

void removeFile(std::string const& path);

/// Tells this process's temporary names from others'.
unsigned long processNumber();

} // namespace host

#endif
