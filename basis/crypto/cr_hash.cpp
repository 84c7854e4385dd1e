#include "zor_basis/crypto/cr_hash.h"

#include "basis/crypto/cr_hash_impl.h"
#include "basis/ground/choices.h"
#include "zor_basis/store/blob.h"

namespace ZOR_Basis {
namespace {

/// The service takes lengths of 32 bits.
constexpr std::uint64_t LARGEST_PIECE = std::uint64_t{1} << 30;

bool exportTo(Blob& out, CryptService::Handle key) {
    std::uint32_t n = 0;
    if (!cryptService.exportKey(key, nullptr, n)) return false;
    out.alloc(n, DISCARDING_BYTES);
    if (out.sizeBuf() < n) return false;
    if (!cryptService.exportKey(key, out.buf(), n)) return false;
    out.setSize(n);
    return true;
}

} // namespace

CrHash::~CrHash() = default;

CrHashWin::~CrHashWin() {
    if (hash_ != 0) cryptService.destroyHash(hash_);
}

bool CrHashWin::hashData(void const* data, std::uint64_t len) {
    if (data == nullptr && len != 0) return false;
    char const* next = static_cast<char const*>(data);
    while (len > LARGEST_PIECE) {
        if (!cryptService.hashData(hash_, next, LARGEST_PIECE)) return false;
        next += LARGEST_PIECE;
        len -= LARGEST_PIECE;
    }
    return cryptService.hashData(hash_, next, static_cast<std::uint32_t>(len));
}

bool CrHashWin::exportKey(Blob& out) {
    CryptService::Handle key = 0;
    if (!cryptService.deriveKey(provider_, hash_, EXPORTABLE, key)) return false;
    bool const done = exportTo(out, key);
    cryptService.destroyKey(key);
    return done;
}

} // namespace ZOR_Basis
