/// \file
/// `IFile`: a stream of bytes, whatever is behind it. Made and held by `File`.
///
/// Three backends exist. What they do differently:
///
/// | | platform layer | runtime stream | runtime descriptor |
/// |---|---|---|---|
/// | `getline` | a line | a line | always 0 |
/// | `seek` | the new position, 0 on failure | 0 on success, else not 0 | the new position, -1 on failure |
/// | `read`, `write` on failure | fewer bytes | fewer bytes | all ones |
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time

#ifndef ZOR_BASIS_FILES_I_FILE_H
#define ZOR_BASIS_FILES_I_FILE_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API IFile {
public:
    IFile() = default;
    IFile(IFile const&) = default;
    IFile& operator=(IFile const&) = default;
    /// Closes the file if it is open.
    virtual ~IFile();

    /// Reads up to n bytes. \return the bytes read; fewer than n at the end of the file and on failure
    /// \kept file-01: a failure of a runtime descriptor is all ones, as the runtime's -1 comes out
    virtual std::uint64_t read(void* buffer, std::uint64_t n) = 0;
    /// Reads one line, its end included, into a buffer of n bytes: at most n - 1 of them and a terminator. The rest of a
    /// longer line comes with the next call. The buffer's last byte becomes 0 in any case.
    /// \return the bytes before the first zero; 0 at the end of the file, for n = 0, and where lines are not supported
    virtual std::uint64_t getline(char* buffer, std::uint64_t n);
    /// Writes n bytes. \return the bytes written; fewer than n, or all ones, on failure
    virtual std::uint64_t write(void const* buffer, std::uint64_t n) = 0;
    /// Hands what is buffered to the system; a runtime descriptor's file is written to the disk.
    virtual bool flush() = 0;
    /// Moves the position. \param origin  0 the start, 1 the position, 2 the end
    /// \kept file-02: the three results differ, as tabled above
    virtual std::int64_t seek(int origin, int offset) = 0;
    virtual bool isOpen() = 0;

    bool operator!() { return !isOpen(); }
};

} // namespace ZOR_Basis

#endif
