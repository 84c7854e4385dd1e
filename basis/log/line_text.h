/// \file
/// Formats the text of a log line.

#ifndef BASIS_LOG_LINE_TEXT_H
#define BASIS_LOG_LINE_TEXT_H

#include <cstdarg>
#include <cstddef>

namespace ZOR_Basis {

/// The arguments of a format, passed by reference: an argument that one function reads is consumed for all.
struct LineArguments {
    std::va_list list;
};

/// Writes the same terminated text as `vsnprintf`, faster. It handles texts, integers, characters and fixed decimals,
/// with their widths, which make up most lines.
/// \param room  counts the bytes at `line`, including the terminator's; at least 1
/// \return the address of the terminator; null if it does not handle the format or an argument, if the text contains a
///     zero, or if the room is too small. In that case the bytes written are meaningless and some arguments have been
///     consumed
char* writeLineText(char* line, std::size_t room, char const* format, LineArguments& arguments);

/// The same by `vsnprintf`, for every format; cuts the text to the room and at its first zero.
/// \return the address of the terminator
char* writeAnyLineText(char* line, std::size_t room, char const* format, LineArguments& arguments);

} // namespace ZOR_Basis

#endif
