/// \file
/// The class behind `Crypt`: holds a provider of the cryptographic service.

#ifndef BASIS_CRYPTO_CRYPT_IMPL_H
#define BASIS_CRYPTO_CRYPT_IMPL_H

#include "basis/crypto/crypt_service.h"
#include "zor_basis/crypto/crypt.h"

namespace ZOR_Basis {

class CryptWin final : public Crypt {
public:
    CryptWin();

    CrHash* createHash() override;
    CrKey* deriveKey(CrHash* hash) override;
    bool isValid() const override { return provider_ != 0; }

private:
    CryptService::Handle provider_ = 0;
};

static_assert(sizeof(CryptWin) == 16);

} // namespace ZOR_Basis

#endif
