/// \file
/// `ZB_Parse`: reads a text in memory line by line, forwards only: a job ticket, a list of files.
///
/// Every call that reads first skips white space, as the runtime's `isspace` defines it. Line ends are white space, so
/// empty lines and leading blanks are never returned. The line then extends up to a line feed, a carriage return, a
/// byte 0 or the end of the text, which it does not include; trailing blanks belong to it.
///
/// Bytes at and beyond the given size are never read. At the end of the text every line is empty.
///
///     ZB_Parse ticket(data, size);
///     if (!ticket.checkLine("BEGIN")) return false;
///     char line[256];
///     while (ticket.skipBlanks() != 0 && !ticket.isDataEnd()) { // a byte 0 ends the text, too
///         ticket.getLine(255, line, nullptr);
///         use(line);
///     }
///
/// \kept parse-01: a byte 0 is neither white space nor part of a line, so nothing behind it is ever read
/// \thread one thread at a time

#ifndef ZOR_BASIS_SYSTEM_PARSE_H
#define ZOR_BASIS_SYSTEM_PARSE_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class FPath;

class ZB_API ZB_Parse {
public:
    /// Begins at the front of the text.
    /// \param data  is borrowed for the life of this object; may be null only if the size is 0
    /// \param size  counts bytes; a negative one counts as 0
    ZB_Parse(char const* data, int size) : data_(data), size_(size) {}

    /// Skips white space.
    /// \return 0 at the end of the text; otherwise the last character examined: the first that is not white space, or
    ///     the last of the text. It is a `char` value, so bytes above 127 come out negative
    int skipBlanks();

    /// Tells whether all bytes have been read.
    bool isDataEnd() const { return position_ >= size_; }
    /// Tells whether a character is a line feed or a carriage return.
    static bool isEndOfLine(char c) { return c == '\n' || c == '\r'; }

    /// Reads a line, or its first part; the next call continues right behind it.
    /// \param maximum  limits the bytes that are read
    /// \param out  has room for `maximum` + 1 bytes; receives the line and a terminator
    /// \param length  receives the line's length; may be null
    /// \return whether a line end follows; false if the line continues, at a byte 0, and at the end of the text
    bool getLine(int maximum, char* out, int* length);

    /// Reads a line, at most 256 bytes of it, and compares it with a text. The line is consumed whatever the result.
    /// \kept parse-02: trailing blanks and letter case count: "BEGIN " does not equal "BEGIN"
    /// \param expected  is the text to compare with; null counts as the empty text
    bool checkLine(char const* expected);

    /// Reads a line, at most 255 bytes of it, as a path, replaces a fake root by the root folder, and checks whether
    /// the path exists.
    /// \param path  receives the path, whether it exists or not; unchanged at the end of the text
    /// \param fileOnly  rejects directories
    /// \param forwardSlashes  replaces every "\" in the path by "/"
    /// \return whether the path names a regular file or, without `fileOnly`, a directory
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
