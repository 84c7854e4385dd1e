/// \file
/// The class behind `CrHash`: holds a hash of the cryptographic service.

#ifndef BASIS_CRYPTO_CR_HASH_IMPL_H
#define BASIS_CRYPTO_CR_HASH_IMPL_H

#include "basis/crypto/crypt_service.h"
#include "zor_basis/crypto/cr_hash.h"

namespace ZOR_Basis {

class CrHashWin final : public CrHash {
public:
    explicit CrHashWin(CryptService::Handle provider) : provider_(provider) {
        cryptService.createHash(provider, hash_);
    }
    CrHashWin(CrHashWin const&) = delete;
    CrHashWin& operator=(CrHashWin const&) = delete;
    ~CrHashWin() override;

    bool hashData(void const* data, std::uint64_t len) override;
    bool isValid() const override { return hash_ != 0; }
    bool exportKey(Blob& out) override;

    CryptService::Handle handle() const { return hash_; }

private:
    CryptService::Handle hash_ = 0;
    CryptService::Handle provider_; // borrowed
};

static_assert(sizeof(CrHashWin) == 24);

} // namespace ZOR_Basis

#endif
