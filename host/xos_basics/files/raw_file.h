/// \file
/// An open file of the system, without any buffer. Twins of raw_file.cpp: raw_file_posix.cpp, raw_file_win.cpp.
///
/// Transfers complete what the system interrupts or does in pieces. What fails leaves the system's last error.

#ifndef HOST_XOS_BASICS_FILES_RAW_FILE_H
#define HOST_XOS_BASICS_FILES_RAW_FILE_H

#include <cstddef>
#include <cstdint>

namespace host {

struct OpenMode {
    bool read;
    bool write;
    bool create;
    bool truncate;
    /// Every write goes to the end that the file then has.
    bool append;
};

class RawFile {
public:
    RawFile() = default;
    RawFile(RawFile const&) = delete;
    RawFile& operator=(RawFile const&) = delete;
    ~RawFile() {
        if (native_ != -1) close();
    }

    /// Opens an entry that is no directory.
    bool open(char const* path, OpenMode mode);
    /// Gives the file back to the system even when it returns false.
    bool close();

    /// \return the bytes read, fewer only at the end of the file or when reading failed
    std::size_t read(char* to, std::size_t size);
    /// One transfer: what is there, at least one byte.
    /// \return 0 at the end of the file; -1: failed
    std::ptrdiff_t readSome(char* to, std::size_t size);
    /// \return the bytes written, fewer only when writing failed
    std::size_t write(char const* from, std::size_t size);
    /// Waits until what was written has reached the device.
    bool flush();
    /// \param origin  0 the start, 1 the current position, 2 the end \return the new position; -1: failed
    std::int64_t seek(std::int64_t offset, int origin);

private:
    std::intptr_t native_ = -1;
    bool append_ = false;
    bool write_ = false;
};

/// Whether the text files of this system end their lines with CR LF.
extern bool const TEXT_LINES_END_IN_CR_LF;

} // namespace host

#endif
