/// \file
/// The text of a log line.

#ifndef BASIS_LOG_LINE_TEXT_H
#define BASIS_LOG_LINE_TEXT_H

#include <cstdarg>
#include <cstddef>

namespace ZOR_Basis {

/// The arguments of a format, in one place: what is read of them is read for everyone.
struct LineArguments {
    std::va_list list;
};

/// Writes the text that `vsnprintf` writes, terminated, by a shorter way: that of texts, integers, characters and fixed
/// decimals, with their widths, of which lines mostly consist.
/// \param room  bytes at `line`, the terminator's included; at least 1
/// \return the terminator; null where the way does not lead to the whole text, which has a zero in it, or the room ends:
///     what was written is of no use then, and the arguments have been read in part
char* writeLineText(char* line, std::size_t room, char const* format, LineArguments& arguments);

/// The same by `vsnprintf`, whatever the format is; cut to the room and at the first zero. \return the terminator
char* writeAnyLineText(char* line, std::size_t room, char const* format, LineArguments& arguments);

} // namespace ZOR_Basis

#endif
