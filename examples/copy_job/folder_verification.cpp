#include "examples/copy_job/folder_verification.h"

#include "examples/copy_job/each_entry.h"

#include <cstring>
#include <vector>

using namespace ZOR_Basis;

namespace {

constexpr std::uint64_t PIECE = 64 * 1024;

bool sameBytes(FPath const& a, FPath const& b) {
    File first(a, File::FILE_READ | File::FILE_BINARY | File::FILE_SEQUENTIAL);
    File second(b, File::FILE_READ | File::FILE_BINARY | File::FILE_SEQUENTIAL);
    if (!first.isOpen() || !second.isOpen()) return false;
    static std::vector<char> firstPiece(PIECE);
    static std::vector<char> secondPiece(PIECE);
    while (true) {
        auto const got = first->read(firstPiece.data(), PIECE);
        if (got != second->read(secondPiece.data(), PIECE)) return false;
        if (got == 0) return true;
        if (std::memcmp(firstPiece.data(), secondPiece.data(), got) != 0) return false;
    }
}

} // namespace

bool FolderVerification::verify(FPath const& source, FPath const& copy) {
    return verifyFiles(source, copy) && forEachEntry(source, LOOK_DIRS, [&](FileEntry& entry) {
               return verify(entry.getFullPath(), FPath(copy, entry.getName()));
           });
}

bool FolderVerification::verifyFiles(FPath const& source, FPath const& copy) {
    return forEachEntry(source, LOOK_FILES, [&](FileEntry& entry) {
        if (!entry.isFile()) return true;
        ++files_;
        if (sameBytes(entry.getFullPath(), FPath(copy, entry.getName()))) return true;
        failedAt_ = entry.getFullPath();
        return false;
    });
}
