/// \file
/// `CrHash`: the running MD5 hash of the bytes fed to it. `Crypt::createHash` makes one.
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_CRYPTO_CR_HASH_H
#define ZOR_BASIS_CRYPTO_CR_HASH_H

#include "zor_basis/export.h"
#include "zor_basis/store/blob.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API CrHash {
public:
    CrHash() = default;
    CrHash(CrHash const&) = default;
    CrHash& operator=(CrHash const&) = default;

    /// Feeds bytes to the hash. The result depends on the bytes in order, not on how they are split into calls.
    /// \return false for an invalid hash, for null with a length, and after a key has been derived or exported
    virtual bool hashData(void const* data, std::uint64_t len) = 0;
    virtual bool isValid() const = 0;
    /// Stores the key derived from the data so far as a plain key blob: 08 02 00 00, 02 66 00 00 (RC2), 10 00 00 00
    /// (its length), and the 16 bytes of the key, 28 bytes in all. Afterwards the hash accepts no more data; deriving
    /// and exporting still give the same key.
    /// \param out  receives the key blob; pass a `SecretBlob`, whose blocks are wiped. If it has too little room, it
    ///     gets a block of exactly that size
    /// \return false if the service refuses or memory is short
    virtual bool exportKey(Blob& out) = 0;

    virtual ~CrHash();
};

} // namespace ZOR_Basis

#endif
