#include "basis/system/registry_win.h"

#include "basis/files/last_error.h"
#include "basis/ground/choices.h"
#include "basis/system/query_calls_win.h"

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t MOST_ROOM = 64 * 1024 * 1024;

} // namespace

bool told(LSTATUS result) {
    if (result != ERROR_SUCCESS) SetLastError(static_cast<DWORD>(result));
    return result == ERROR_SUCCESS;
}

bool growBuffer(Blob& buffer, std::uint64_t reported) {
    std::uint64_t const room = reported > buffer.sizeBuf() ? reported : 2 * buffer.sizeBuf();
    if (room == 0 || room > MOST_ROOM) return false;
    buffer.alloc(room, DISCARDING_BYTES);
    return buffer.sizeBuf() >= room;
}

bool isText(DWORD type) { return type == REG_SZ || type == REG_EXPAND_SZ || type == REG_MULTI_SZ; }

RegistryKey::RegistryKey(HKEY parent, char const* path, REGSAM access) {
    if (!told(queryCalls.openKey(parent, path, 0, access, &key_))) key_ = nullptr;
}

RegistryKey::~RegistryKey() {
    if (!isOpen()) return;
    KeepLastError const keep;
    queryCalls.closeKey(key_);
}

bool RegistryKey::has(char const* value) const {
    return isOpen() && told(queryCalls.queryValue(key_, value, nullptr, nullptr, nullptr, nullptr));
}

bool RegistryKey::read(char const* value, Blob& buffer, Growth growth) const {
    if (!isOpen()) return false;
    buffer.alloc(VALUE_ROOM, DISCARDING_BYTES);
    if (buffer.sizeBuf() < VALUE_ROOM) return false;
    DWORD type = REG_NONE;
    DWORD n = 0;
    auto const ask = [&] {
        n = static_cast<DWORD>(buffer.sizeBuf());
        return queryCalls.queryValue(key_, value, nullptr, &type, reinterpret_cast<BYTE*>(buffer.buf()), &n);
    };
    LSTATUS result = ask();
    if (result == ERROR_MORE_DATA && growth == ONCE && growBuffer(buffer, n)) result = ask();
    if (!told(result == ERROR_SUCCESS && !isText(type) ? ERROR_UNSUPPORTED_TYPE : result)) return false;
    buffer.setSize(n);
    return true;
}

} // namespace ZOR_Basis
