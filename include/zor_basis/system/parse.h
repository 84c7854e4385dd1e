/// \file
/// `ZB_Parse`: reads a text in memory line by line, forwards only: a job ticket, a list of files.
///
/// Every reading call first skips white space as the runtime's `isspace` has it. Line ends are white space, so empty lines
/// never show, and neither do blanks at a line's front. The line then goes up to, and does not take, a line feed, a
/// carriage return, a byte 0 or the text's end; blanks at its end belong to it.
///
/// No byte at or behind the given size is ever looked at. At the end every line is empty.
///
/// \kept parse-01: a byte 0 is neither white space nor part of a line, so nothing behind it is ever reached
/// \thread  one thread at a time

#ifndef ZOR_BASIS_SYSTEM_PARSE_H
#define ZOR_BASIS_SYSTEM_PARSE_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class FPath;

class ZB_API ZB_Parse {
public:
    /// Reads from the front.
    /// \param data  borrowed for the life of this object; not null unless the size is 0
    /// \param size  in bytes; below 0 is as 0
    ZB_Parse(char const* data, int size) : data_(data), size_(size) {}

    /// Skips white space.
    /// \return 0 at the end of the text; else the last character that was looked at: the first that is no white space, or
    ///         the text's last one; as a `char`, so above 127 below 0
    int skipBlanks();

    bool isDataEnd() const { return position_ >= size_; }
    /// Line feed and carriage return only.
    static bool isEndOfLine(char c) { return c == '\n' || c == '\r'; }

    /// Reads a line, or as much of it as is asked for; the next call goes on right behind that.
    /// \param maximum  bytes to read at most
    /// \param out  room for `maximum` + 1 bytes; receives the line and a terminator
    /// \param length  null, or receives the line's length
    /// \return whether a line end follows; false where the line goes on, and at a byte 0 and at the text's end
    bool getLine(int maximum, char* out, int* length);

    /// Reads a line, of a longer one the first 256 bytes, and compares it with a text; it is read whatever comes out.
    /// \kept parse-02: blanks at the line's end count, as do upper and lower case: "BEGIN " is not "BEGIN"
    /// \param expected  null is the empty text
    bool checkLine(char const* expected);

    /// Reads a line, of a longer one the first 255 bytes, as a path, with the root folder in place of a fake root, and looks
    /// whether it is there.
    /// \param path  receives the path, whether it is there or not; stays as it was at the end of the text
    /// \param fileOnly  does without directories
    /// \param forwardSlashes  turns every "\" in the path into "/"
    /// \return whether the path is that of a regular file or a directory
    bool getCleanFileName(FPath& path, bool fileOnly, bool forwardSlashes);

private:
    /// A part of the text.
    struct Line {
        char const* text;
        std::uint64_t size;
    };

    Line readLine(int maximum);

    char const* data_;
    std::int32_t size_;
    std::int32_t position_ = 0;
};

static_assert(sizeof(ZB_Parse) == 16);

} // namespace ZOR_Basis

#endif
