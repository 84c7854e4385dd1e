/// \file
/// The class behind `CrKey`: holds a key of the cryptographic service.

#ifndef BASIS_CRYPTO_CR_KEY_IMPL_H
#define BASIS_CRYPTO_CR_KEY_IMPL_H

#include "basis/crypto/crypt_service.h"
#include "zor_basis/crypto/cr_key.h"

namespace ZOR_Basis {

class CrKeyWin final : public CrKey {
public:
    /// Derives the key from a hash.
    CrKeyWin(CryptService::Handle provider, CryptService::Handle hash) {
        cryptService.deriveKey(provider, hash, NOT_EXPORTABLE, key_);
    }
    CrKeyWin(CrKeyWin const&) = delete;
    CrKeyWin& operator=(CrKeyWin const&) = delete;
    ~CrKeyWin() override;

    bool encrypt(Blob const& in, Blob& out) override;
    bool decrypt(Blob const& in, Blob& out) override;
    bool isValid() const override { return key_ != 0; }

private:
    CryptService::Handle key_ = 0;
};

static_assert(sizeof(CrKeyWin) == 16);

} // namespace ZOR_Basis

#endif
