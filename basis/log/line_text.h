/// \file
/// The text of a log line.

#ifndef BASIS_LOG_LINE_TEXT_H
#define BASIS_LOG_LINE_TEXT_H

#include <cstdarg>
#include <cstddef>

namespace ZOR_Basis {

/// Writes the text that `vsnprintf` writes, terminated and cut to the room. What lines mostly consist of (texts, integers,
/// characters, fixed decimals, with widths) takes a shorter way there.
/// \param room  bytes at `line`, the terminator's included; at least 1
void writeLineText(char* line, std::size_t room, char const* format, std::va_list arguments);

/// The shorter way alone. \return false where it does not lead to the whole text; what was written then is of no use
bool writeLineTextQuickly(char* line, std::size_t room, char const* format, std::va_list arguments);

} // namespace ZOR_Basis

#endif
