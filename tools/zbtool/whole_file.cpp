#include "tools/zbtool/whole_file.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/staging.h"

#include <zor_basis/files.h>

#include <filesystem>
#include <iostream>
#include <iterator>
#include <vector>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

constexpr std::uint64_t PIECE = 64 * 1024;

/// Calls `take(bytes, size)` for each piece of a file.
template <class Take>
bool readPieces(std::string const& path, std::string& reason, Take take) {
    // Opening a folder succeeds on some systems.
    bool const isFolder = FStat(path.c_str()).isDir();
    File file(path.c_str(), File::FILE_READ | File::FILE_BINARY | File::FILE_SEQUENTIAL);
    if (isFolder || !file) {
        reason = isFolder ? "is a folder" : lastReason();
        return false;
    }
    std::vector<char> piece(PIECE);
    while (std::uint64_t const got = file->read(piece.data(), PIECE)) take(piece.data(), got);
    return true;
}

bool write(std::string const& path, void const* bytes, std::uint64_t size, std::string& reason) {
    auto const fill = [&](FPath const& staged) {
        File file(staged, File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY);
        return file.isOpen() && file->write(bytes, size) == size && file->flush();
    };
    return writeStaged(path, fill, OVERWRITING, reason);
}

} // namespace

bool readWhole(std::string const& path, std::string& text, std::string& reason) {
    if (path == "-") {
        text.assign(std::istreambuf_iterator<char>(std::cin), {});
        return true;
    }
    return readPieces(path, reason, [&](char const* bytes, std::uint64_t size) { text.append(bytes, size); });
}

bool readWhole(std::string const& path, Blob& bytes, std::string& reason) {
    bytes.alloc(FStat::size(path.c_str()), false);
    return readPieces(path, reason, [&](char const* piece, std::uint64_t size) { bytes.add(size, piece); });
}

bool isSameFile(std::string const& path, std::string const& other) {
    std::error_code error;
    return std::filesystem::equivalent(path, other, error);
}

bool writeWhole(std::string const& path, std::string const& text, std::string& reason) {
    return write(path, text.data(), text.size(), reason);
}

bool writeWhole(std::string const& path, Blob const& bytes, std::string& reason) {
    return write(path, bytes.val(), bytes.size(), reason);
}

} // namespace zbtool
