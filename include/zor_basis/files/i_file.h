/// \file
/// `IFile`: the interface of a byte stream. `File` makes and holds it.
///
/// There are three backends, which differ as follows:
///
/// | | platform layer | runtime stream | runtime descriptor |
/// |---|---|---|---|
/// | `getline` | reads a line | reads a line | always returns 0 |
/// | `seek` | the new position, 0 on failure | 0 on success, else not 0 | the new position, -1 on failure |
/// | `read`, `write` on failure | fewer bytes | fewer bytes | all ones |
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time

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

    /// Reads up to n bytes.
    /// \return the number of bytes read; fewer than n at the end of the file and on failure
    /// \kept file-01: a runtime descriptor reports failure by all ones, which is the runtime's -1
    virtual std::uint64_t read(void* buffer, std::uint64_t n) = 0;
    /// Reads one line, including its end, into a buffer of n bytes: at most n - 1 bytes and a terminator. The next call
    /// returns the rest of a longer line. The buffer's last byte is always set to 0.
    /// \return the number of bytes before the first zero; 0 at the end of the file, for n = 0, and in a backend without
    ///     lines
    virtual std::uint64_t getline(char* buffer, std::uint64_t n);
    /// Writes n bytes.
    /// \return the number of bytes written; fewer than n, or all ones, on failure
    virtual std::uint64_t write(void const* buffer, std::uint64_t n) = 0;
    /// Passes buffered data to the system; for a runtime descriptor the file is written to the disk.
    virtual bool flush() = 0;
    /// Moves the position.
    /// \param origin  selects the base of the offset: 0 the start, 1 the current position, 2 the end
    /// \kept file-02: the results of the three backends differ as in the table above
    virtual std::int64_t seek(int origin, int offset) = 0;
    virtual bool isOpen() = 0;

    /// Tells whether the file is closed.
    bool operator!() { return !isOpen(); }
};

} // namespace ZOR_Basis

#endif
