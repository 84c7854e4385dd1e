// The sibling is crypt_service_posix.cpp.

#include "basis/crypto/crypt_service.h"

#include "basis/platform/windows_api_win.h"

#include <wincrypt.h>

namespace ZOR_Basis {
namespace {

using Handle = CryptService::Handle;

static_assert(sizeof(HCRYPTPROV) == sizeof(Handle) && sizeof(HCRYPTHASH) == sizeof(Handle) &&
              sizeof(HCRYPTKEY) == sizeof(Handle));
static_assert(sizeof(DWORD) == sizeof(std::uint32_t));

constexpr DWORD KEY_BITS = 128;
constexpr unsigned KEY_BITS_SHIFT = 16;
constexpr DWORD EXPORTED_KEY = KEY_BITS << KEY_BITS_SHIFT | CRYPT_EXPORTABLE;
static_assert(EXPORTED_KEY == 0x800001);

BYTE* bytes(char* data) { return reinterpret_cast<BYTE*>(data); }

/// A handle as the service stores it, whose type is another name for the same.
template <class Call>
bool storeHandle(Handle& handle, Call call) {
    ULONG_PTR stored = 0;
    if (call(&stored) == FALSE) return false;
    handle = stored;
    return true;
}

template <class Call>
bool storeLength(std::uint32_t& n, Call call) {
    DWORD length = n;
    bool const done = call(&length) != FALSE;
    n = length;
    return done;
}

bool acquire(Handle& provider, bool newKeySet) {
    DWORD const flags = CRYPT_VERIFYCONTEXT | (newKeySet ? CRYPT_NEWKEYSET : 0);
    return storeHandle(provider,
                       [=](auto* out) { return CryptAcquireContextA(out, nullptr, nullptr, PROV_RSA_FULL, flags); });
}

bool createHash(Handle provider, Handle& hash) {
    return storeHandle(hash, [=](auto* out) { return CryptCreateHash(provider, CALG_MD5, 0, 0, out); });
}

bool hashData(Handle hash, void const* data, std::uint32_t n) {
    return CryptHashData(hash, static_cast<BYTE const*>(data), n, 0) != FALSE;
}

void destroyHash(Handle hash) { CryptDestroyHash(hash); }

bool deriveKey(Handle provider, Handle hash, bool exportable, Handle& key) {
    DWORD const flags = exportable ? EXPORTED_KEY : 0;
    return storeHandle(key, [=](auto* out) { return CryptDeriveKey(provider, CALG_RC2, hash, flags, out); });
}

bool exportKey(Handle key, char* blob, std::uint32_t& n) {
    return storeLength(n,
                       [=](DWORD* length) { return CryptExportKey(key, 0, PLAINTEXTKEYBLOB, 0, bytes(blob), length); });
}

bool encrypt(Handle key, char* data, std::uint32_t& n, std::uint32_t room) {
    return storeLength(n, [=](DWORD* length) { return CryptEncrypt(key, 0, TRUE, 0, bytes(data), length, room); });
}

bool decrypt(Handle key, char* data, std::uint32_t& n) {
    // Some versions of the service read beyond such a message instead of refusing it.
    if (!isWholeBlocks(n)) {
        SetLastError(static_cast<DWORD>(NTE_BAD_DATA));
        return false;
    }
    return storeLength(n, [=](DWORD* length) { return CryptDecrypt(key, 0, TRUE, 0, bytes(data), length); });
}

void destroyKey(Handle key) { CryptDestroyKey(key); }

std::uint32_t lastError() { return GetLastError(); }

} // namespace

CryptService cryptService{acquire,   createHash, hashData, destroyHash, deriveKey,
                          exportKey, encrypt,    decrypt,  destroyKey,  lastError};

} // namespace ZOR_Basis
