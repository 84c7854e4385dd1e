/// \file
/// The three kinds of open files behind `IFile`.

#ifndef BASIS_FILES_FILE_BACKENDS_H
#define BASIS_FILES_FILE_BACKENDS_H

#include "basis/platform/xos_basics.h"
#include "zor_basis/files/i_file.h"
#include "zor_basis/wide_char.h"

#include <cstdio>
#include <utility>

namespace ZOR_Basis {

/// A file of the platform layer.
class FileXosBasics final : public IFile {
public:
    FileXosBasics(char const* path, int mode);
    FileXosBasics(FileXosBasics const&) = delete;
    FileXosBasics& operator=(FileXosBasics const&) = delete;
    ~FileXosBasics() override;

    std::uint64_t read(void* buffer, std::uint64_t n) override;
    std::uint64_t getline(char* buffer, std::uint64_t n) override;
    std::uint64_t write(void const* buffer, std::uint64_t n) override;
    bool flush() override;
    std::int64_t seek(int origin, int offset) override;
    bool isOpen() override { return handle_ != 0; }
    /// Closes the file before the object is destroyed.
    /// \return whether all written data has arrived
    bool close() { return xos_FileCloseEx(std::exchange(handle_, 0), 0) == 0; }

private:
    xos_File handle_;
};

/// A stream of the runtime library.
class FileStdBuf final : public IFile {
public:
    FileStdBuf(char const* path, int mode);
    FileStdBuf(WChar const* path, int mode);
    FileStdBuf(FileStdBuf const&) = delete;
    FileStdBuf& operator=(FileStdBuf const&) = delete;
    ~FileStdBuf() override;

    std::uint64_t read(void* buffer, std::uint64_t n) override;
    std::uint64_t getline(char* buffer, std::uint64_t n) override;
    std::uint64_t write(void const* buffer, std::uint64_t n) override;
    bool flush() override;
    std::int64_t seek(int origin, int offset) override;
    bool isOpen() override { return stream_ != nullptr; }

private:
    /// If false, the last error says why.
    bool canBeUsed() const;
    char const* nextLine(char* buffer, int room);

    std::FILE* stream_;
};

/// A descriptor of the runtime library: file_std_dir_win.cpp, file_std_dir_posix.cpp.
class FileStdDir final : public IFile {
public:
    FileStdDir(char const* path, int mode);
    FileStdDir(FileStdDir const&) = delete;
    FileStdDir& operator=(FileStdDir const&) = delete;
    ~FileStdDir() override;

    std::uint64_t read(void* buffer, std::uint64_t n) override;
    std::uint64_t write(void const* buffer, std::uint64_t n) override;
    bool flush() override;
    std::int64_t seek(int origin, int offset) override;
    bool isOpen() override { return descriptor_ != -1; }

private:
    int descriptor_;
};

/// The mode text of a stream, such as "r+Sb"; empty where the mode opens nothing.
struct StreamMode {
    explicit StreamMode(int mode);
    char text[8] = {};
};

} // namespace ZOR_Basis

#endif
