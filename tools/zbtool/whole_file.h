/// \file
/// Reads and writes whole files.

#ifndef TOOLS_ZBTOOL_WHOLE_FILE_H
#define TOOLS_ZBTOOL_WHOLE_FILE_H

#include <zor_basis/store/blob.h>

#include <string>

namespace zbtool {

/// \param path  "-" means standard input
/// \param reason  receives why the file cannot be read
bool readWhole(std::string const& path, std::string& text, std::string& reason);
/// The same into a blob, which can wipe its bytes.
bool readWhole(std::string const& path, ZOR_Basis::Blob& bytes, std::string& reason);

/// Whether two paths lead to one existing file, however they are written.
bool isSameFile(std::string const& path, std::string const& other);

/// Replaces a file: afterwards it is the new one, or the old one if that fails.
bool writeWhole(std::string const& path, std::string const& text, std::string& reason);
bool writeWhole(std::string const& path, ZOR_Basis::Blob const& bytes, std::string& reason);

} // namespace zbtool

#endif
