/// \file
/// What an `xos_File` stands for: a file of the system with its read-ahead.
///
/// Lines and small reads come from a buffer; large reads and all writes go straight to the system, so that nothing
/// written waits in the process. The position that the system keeps runs ahead of the caller's by what is unread.

#ifndef HOST_XOS_BASICS_FILES_OPEN_FILE_H
#define HOST_XOS_BASICS_FILES_OPEN_FILE_H

#include "host/xos_basics/files/raw_file.h"

#include <memory>

namespace host {

class OpenFile {
public:
    /// Takes the flags of `xos_FileOpen`.
    bool open(char const* path, std::uint32_t flags);
    bool close() { return file_.close(); }

    std::size_t read(char* to, std::size_t size);
    std::size_t write(char const* from, std::size_t size);
    /// Reads one line, its end included, into `size` bytes.
    /// \return false: nothing was left
    bool gets(char* to, std::size_t size);
    bool flush() { return file_.flush(); }
    bool seek(std::int64_t offset, int origin);
    /// \return -1 on failure
    std::int64_t tell();

private:
    std::size_t unread() const { return end_ - next_; }
    /// Reads ahead when nothing is unread.
    /// \return false at the end of the file, or on failure
    bool fill();
    std::size_t take(char* to, std::size_t size);
    /// Puts the system's position back to the caller's.
    void forgetUnread();
    std::size_t readText(char* to, std::size_t size);
    std::size_t writeText(char const* from, std::size_t size);
    /// The next character, CR LF being one; -1 when there is none.
    int nextOfText();

    RawFile file_;
    bool text_ = false;
    std::unique_ptr<char[]> buffer_;
    std::size_t next_ = 0;
    std::size_t end_ = 0;
};

} // namespace host

#endif
