#include "zor_basis/crypto/crypt.h"

#include "basis/crypto/cr_hash_impl.h"
#include "basis/crypto/cr_key_impl.h"
#include "basis/crypto/crypt_impl.h"
#include "zor_basis/text/buf_str.h"

#include <new>

namespace ZOR_Basis {
namespace {

/// Reports the reason to a debugger.
void describeFailure() {
    BufStr<255> text("CryptWin(): CryptAcquireContext() failed. Error: ");
    // kept crypto-03: callers probe for the service, so a missing one is not logged.
    text << cryptService.lastError();
}

} // namespace

// kept crypto-02: no release, here or in CryptWin; the handles that were made from a provider need it as long as they
// live.
Crypt::~Crypt() = default;

Crypt* Crypt::make(char const*) {
    // kept crypto-01: the name is ignored; it is always this provider.
    return new (std::nothrow) CryptWin;
}

CryptWin::CryptWin() {
    if (cryptService.acquire(provider_, EXISTING_KEY_SET) || cryptService.acquire(provider_, NEW_KEY_SET)) return;
    describeFailure();
}

CrHash* CryptWin::createHash() { return new (std::nothrow) CrHashWin(provider_); }

CrKey* CryptWin::deriveKey(CrHash* hash) {
    CryptService::Handle const handle = hash != nullptr ? static_cast<CrHashWin const*>(hash)->handle() : 0;
    return new (std::nothrow) CrKeyWin(provider_, handle);
}

} // namespace ZOR_Basis
