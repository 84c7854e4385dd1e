/// \file
/// UTF-8, character by character.

#ifndef TOOLS_ZBTOOL_UTF8_H
#define TOOLS_ZBTOOL_UTF8_H

#include <cstdint>
#include <string>
#include <string_view>

namespace zbtool {

/// Returns the length of the character at the front of a text in bytes; 0 if no valid one begins there.
std::size_t utf8Length(std::string_view text);
/// Returns the length of what could be the beginning of a character at the end of a text; 0 if it ends with whole ones.
std::size_t unfinishedLength(std::string_view text);
/// Tells whether a text is valid UTF-8.
bool isUtf8(std::string_view text);
void appendUtf8(std::string& text, std::uint32_t codePoint);

} // namespace zbtool

#endif
