/// \file
/// The classes behind `Crypt`, `CrHash` and `CrKey`: each holds a handle of the cryptographic service.

#ifndef BASIS_CRYPTO_CRYPT_IMPL_H
#define BASIS_CRYPTO_CRYPT_IMPL_H

#include "basis/crypto/crypt_service.h"
#include "zor_basis/crypto/cr_hash.h"
#include "zor_basis/crypto/cr_key.h"
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

class CrKeyWin final : public CrKey {
public:
    CrKeyWin(CryptService::Handle provider, CryptService::Handle hash) {
        cryptService.deriveKey(provider, hash, false, key_);
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

static_assert(sizeof(CryptWin) == 16 && sizeof(CrHashWin) == 24 && sizeof(CrKeyWin) == 16);

} // namespace ZOR_Basis

#endif
