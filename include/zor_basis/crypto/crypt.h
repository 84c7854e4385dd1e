/// \file
/// `Crypt`: a provider of hashes and keys. Four steps lead from secret text to encrypted bytes:
///
///     Crypt* crypt = Crypt::make("");
///     CrHashPtr hash(crypt);
///     hash->hashData("secret", 6);
///     CrKey* key = crypt->deriveKey(hash);
///     key->encrypt(plain, encrypted);
///     delete key;
///
/// **What it computes.** The hash is MD5. The key is an RC2 key of 128 effective bits, the 16 bytes of the digest. The
/// data is padded to whole blocks of 8 bytes with 1 to 8 bytes that each give their number (PKCS#5), and encrypted in
/// CBC mode with an initialisation vector of zeros. Sources: RFC 1321, RFC 2268. On Windows these are the defaults of
/// the system's cryptographic service; on Linux nettle computes the same bytes.
///
/// **What it is good for.** It reads what other modules wrote, and writes what they can read. MD5 and RC2 do not
/// protect a secret against a determined attacker, and nothing detects a changed message (docs/cryptography.md).
///
/// The caller supplies the secrets; the library stores them nowhere. Memory in which it keeps anything of them is
/// filled with zeros before it is released.
///
/// \thread one thread at a time for each object; different threads may use different objects

#ifndef ZOR_BASIS_CRYPTO_CRYPT_H
#define ZOR_BASIS_CRYPTO_CRYPT_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class CrHash;
class CrKey;

class ZB_API Crypt {
public:
    Crypt() = default;
    Crypt(Crypt const&) = default;
    Crypt& operator=(Crypt const&) = default;

    /// Makes a hash, owned by the caller. It may outlive the provider.
    /// \error null only if memory is short; `CrHash::isValid` tells whether the hash can be used
    virtual CrHash* createHash() = 0;
    /// Derives a key from the data hashed so far; the caller owns it. Equal secrets give equal keys. The key may
    /// outlive hash and provider.
    /// \param hash  comes from `createHash` of a provider and accepts no more data afterwards. Null gives an invalid
    ///     key
    /// \error null only if memory is short; `CrKey::isValid` tells whether the key can be used
    virtual CrKey* deriveKey(CrHash* hash) = 0;
    /// Tells whether the cryptographic service is available.
    virtual bool isValid() const = 0;

    virtual ~Crypt();

    /// Makes a provider, owned by the caller.
    /// \param name  \kept crypto-01: the name is ignored and may be null: there is only one service
    /// \kept crypto-02: the system's resources for a provider are never released, so its hashes and keys may be
    ///     destroyed in any order. Make one provider per process rather than one per message
    /// \kept crypto-03: if the service is not available, the function returns an invalid provider and does not report
    ///     why
    /// \error null only if memory is short
    static Crypt* make(char const* name);
};

} // namespace ZOR_Basis

#endif
