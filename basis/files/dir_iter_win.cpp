// The sibling is dir_iter_posix.cpp.

#include "basis/files/dir_iter.h"

#include "basis/platform/windows_api_win.h"

#include <new>

namespace ZOR_Basis {
namespace {

constexpr std::int64_t UNITS_PER_SECOND = 10'000'000;
constexpr std::int64_t SECONDS_FROM_1601_TO_1970 = 11'644'473'600;

std::uint64_t join(DWORD high, DWORD low) { return static_cast<std::uint64_t>(high) << 32 | low; }

class WinDirIterW final : public SystemDirIterW {
public:
    WinDirIterW(LookForType type, WChar const* path) : SystemDirIterW(type, path) {}
    ~WinDirIterW() override { close(); }

    WChar const* next() override {
        while (step()) {
            if (isDots(found_.cFileName)) continue;
            if (isWanted(isDir())) return found_.cFileName;
        }
        return nullptr;
    }

    bool isDir() override { return !isFile(); }
    bool isFile() override { return (found_.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) == 0; }
    std::int64_t time() override {
        FILETIME const& written = found_.ftLastWriteTime;
        auto const units = static_cast<std::int64_t>(join(written.dwHighDateTime, written.dwLowDateTime));
        return units / UNITS_PER_SECOND - SECONDS_FROM_1601_TO_1970;
    }
    std::uint64_t size() override { return join(found_.nFileSizeHigh, found_.nFileSizeLow); }

private:
    static bool isDots(WChar const* name) {
        return name[0] == '.' && (name[1] == 0 || (name[1] == '.' && name[2] == 0));
    }

    bool step() {
        bool const good = first_ ? start() : search_ != INVALID_HANDLE_VALUE && FindNextFileW(search_, &found_) != 0;
        if (!good && lastError_ == 0) lastError_ = GetLastError();
        return good;
    }

    bool start() {
        first_ = false;
        appendWildCard();
        search_ = FindFirstFileW(path_, &found_);
        return search_ != INVALID_HANDLE_VALUE;
    }

    void close() override {
        if (search_ != INVALID_HANDLE_VALUE) FindClose(search_);
        search_ = INVALID_HANDLE_VALUE;
    }

    WIN32_FIND_DATAW found_{};
    HANDLE search_ = INVALID_HANDLE_VALUE;
};

} // namespace

DirIterImplW* DirIterImplW::Make(LookForType type, WChar const* path) {
    return new (std::nothrow) WinDirIterW(type, path);
}

} // namespace ZOR_Basis
