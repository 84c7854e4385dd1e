/// \file
/// Bytes as text for people and for other programs.

#ifndef TOOLS_ZBTOOL_BYTE_TEXT_H
#define TOOLS_ZBTOOL_BYTE_TEXT_H

#include <string>
#include <string_view>

namespace zbtool {

/// Two lower-case digits for each byte.
std::string hexText(std::string_view bytes);
/// \return false for an odd number of digits and for any other character
bool readHex(std::string_view text, std::string& bytes);

/// The text itself, with \xNN for control characters and for bytes that are not UTF-8, and \\ for a backslash.
std::string visibleText(std::string_view bytes);

/// The text with \xNN for what a terminal obeys rather than shows, and all else as it is.
std::string harmlessText(std::string_view bytes);
/// The same for lines, whose ends and tabs stay.
std::string harmlessLines(std::string_view bytes);

} // namespace zbtool

#endif
