/// \file
/// `Crypt`: a provider of hashes and of keys. From secret text to encrypted bytes it is four steps:
///
///     Crypt* crypt = Crypt::make("");
///     CrHashPtr hash(crypt);
///     hash->hashData("secret", 6);
///     CrKey* key = crypt->deriveKey(hash);
///     key->encrypt(plain, encrypted);
///     delete key;
///
/// **What it computes**: the hash is MD5. The key is RC2 with 128 bits, all of them effective, and is the 16 bytes of the
/// digest. Data is encrypted in blocks of 8 bytes, each chained to the one before (CBC, from 8 zero bytes), after it has
/// been padded to whole blocks with 1 to 8 bytes that say how many they are (PKCS#5). Sources: RFC 1321, RFC 2268. On
/// Windows that is what the system's cryptographic service yields by default, on Linux the same bytes come from nettle.
///
/// **What it is good for**: reading what other modules wrote, and writing what they can read. MD5 and RC2 keep nothing
/// secret from someone who wants it, and nothing tells whether a message has been changed (docs/cryptography.md).
///
/// Secrets come from the caller and are stored nowhere. What the library keeps of them is filled with zeros before its
/// memory is released.
///
/// \thread  one thread at a time; objects of their own may be used by any number of threads

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

    /// A new hash, owned by the caller. It may outlive the provider.
    /// \error never null but where memory is short; `CrHash::isValid` tells whether the hash can be used
    virtual CrHash* createHash() = 0;
    /// A new key of what has been hashed so far, owned by the caller. Equal secrets give equal keys. The key may outlive
    /// hash and provider.
    /// \param hash  made by `createHash` of a provider; it takes no more data from now on. Null gives an invalid key
    /// \error never null but where memory is short; `CrKey::isValid` tells whether the key can be used
    virtual CrKey* deriveKey(CrHash* hash) = 0;
    /// Whether there is a cryptographic service behind it.
    virtual bool isValid() const = 0;

    virtual ~Crypt();

    /// A new provider, owned by the caller.
    /// \param name  \kept crypto-01: ignored, null included: there is one service only
    /// \kept crypto-02: what the system keeps for a provider is never given back, so that its hashes and keys need no
    ///     order of destruction. Make one for a process rather than one for a message
    /// \kept crypto-03: where the service cannot be had, an invalid provider comes back and nobody is told why
    /// \error null only where memory is short
    static Crypt* make(char const* name);
};

} // namespace ZOR_Basis

#endif
