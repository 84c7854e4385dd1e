#include "zor_basis/crypto/cr_key.h"

#include "basis/crypto/cr_key_impl.h"
#include "zor_basis/store/blob.h"

#include <algorithm>
#include <limits>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t MOST = std::numeric_limits<std::uint32_t>::max();
/// The service takes lengths of 32 bits.
constexpr std::uint64_t LARGEST_ENCRYPTED = MOST - MOST % CRYPT_BLOCK;
constexpr std::uint64_t LARGEST_PLAIN = LARGEST_ENCRYPTED - 1;

/// Makes room in `out` and copies the message into it, unless it is there already.
bool bring(Blob const& in, Blob& out, std::uint64_t room) {
    bool const inPlace = &in == &out;
    out.alloc(room, inPlace);
    if (out.sizeBuf() < room) return false;
    if (!inPlace) out.copy(in.size(), in.val());
    return true;
}

} // namespace

CrKey::~CrKey() = default;

CrKeyWin::~CrKeyWin() {
    if (key_ != 0) cryptService.destroyKey(key_);
}

bool CrKeyWin::encrypt(Blob const& in, Blob& out) {
    if (in.size() > LARGEST_PLAIN) return false;
    std::uint32_t n = static_cast<std::uint32_t>(in.size());
    // If the service does not tell the length, the call below fails when there is too little room.
    cryptService.encrypt(key_, nullptr, n, 0);
    if (!bring(in, out, n) || out.buf() == nullptr) return false;
    n = static_cast<std::uint32_t>(out.size());
    std::uint32_t const room = static_cast<std::uint32_t>(std::min(out.sizeBuf(), MOST));
    // kept crypto-04: what is in `out` now stays there, as callers encrypt in place and must not lose the message.
    if (!cryptService.encrypt(key_, out.buf(), n, room)) return false;
    out.setSize(n);
    return true;
}

bool CrKeyWin::decrypt(Blob const& in, Blob& out) {
    if (in.size() > LARGEST_ENCRYPTED || !bring(in, out, in.size())) return false;
    std::uint32_t n = static_cast<std::uint32_t>(out.size());
    if (!cryptService.decrypt(key_, out.buf(), n)) return false;
    out.setSize(n);
    return true;
}

} // namespace ZOR_Basis
