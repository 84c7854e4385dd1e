#include "host/xos_basics/files/path_win.h"

namespace host {

namespace {

/// From here on a path, with a name appended, could pass the limit of the ordinary form.
constexpr std::size_t LONG_PATH = 200;

bool widened(char const* path, std::wstring& wide) {
    if (*path == '\0') return failWith(ERROR_PATH_NOT_FOUND);
    int const size = MultiByteToWideChar(CP_ACP, MB_ERR_INVALID_CHARS, path, -1, nullptr, 0);
    if (size == 0) return false;
    wide.resize(static_cast<std::size_t>(size));
    MultiByteToWideChar(CP_ACP, MB_ERR_INVALID_CHARS, path, -1, wide.data(), size);
    wide.pop_back();
    unifySlashes(wide, L'\\');
    return true;
}

bool hasPrefix(std::wstring const& path) {
    return path.compare(0, 4, L"\\\\?\\") == 0 || path.compare(0, 4, L"\\\\.\\") == 0;
}

bool makeFull(std::wstring& path) {
    if (hasPrefix(path)) return true;
    std::wstring full;
    for (DWORD size = GetFullPathNameW(path.c_str(), 0, nullptr, nullptr);;) {
        if (size == 0) return false;
        full.resize(size);
        DWORD const length = GetFullPathNameW(path.c_str(), size, full.data(), nullptr);
        if (length < size) {
            full.resize(length);
            if (length == 0) return false;
            break;
        }
        size = length;
    }
    bool const share = full.compare(0, 2, L"\\\\") == 0;
    path = share ? L"\\\\?\\UNC\\" + full.substr(2) : L"\\\\?\\" + full;
    return true;
}

/// Where the last two letters are a drive, the slash behind them belongs to it.
void cutEnd(std::wstring& path) {
    cutEndSlashes(path);
    if (path.back() == L':') path += L'\\';
}

} // namespace

bool systemPath(char const* path, std::wstring& wide) {
    return widened(path, wide) && (wide.size() < LONG_PATH || makeFull(wide));
}

bool fullPath(char const* path, std::wstring& wide) {
    if (!widened(path, wide) || !makeFull(wide)) return false;
    cutEnd(wide);
    return true;
}

bool isRoot(std::wstring const& full) {
    if (full.back() == L'\\') return true;
    if (full.compare(0, 8, L"\\\\?\\UNC\\") != 0) return false;
    std::size_t const share = full.find(L'\\', 8);
    return share == std::wstring::npos || full.find(L'\\', share + 1) == std::wstring::npos;
}

std::size_t nameOffset(std::wstring const& path) {
    std::size_t const separator = path.find_last_of(L"\\:");
    return separator == std::wstring::npos ? 0 : separator + 1;
}

} // namespace host
