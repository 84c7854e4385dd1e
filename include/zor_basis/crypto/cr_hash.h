/// \file
/// `CrHash`: the running MD5 hash of the bytes fed to it. Made by `Crypt::createHash`.
///
/// \thread  one thread at a time

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

    /// Feeds bytes. What counts is their order, not the pieces in which they come.
    /// \return false for an invalid hash, for null with a length, and once a key has been derived or exported
    virtual bool hashData(void const* data, std::uint64_t len) = 0;
    virtual bool isValid() const = 0;
    /// Stores the key of what has been hashed so far as a plain key blob: 08 02 00 00, 02 66 00 00 (RC2), 10 00 00 00 (its
    /// length), and the 16 bytes of the key, 28 bytes in all. The hash takes no more data from now on; deriving and
    /// exporting go on to give the same key.
    /// \param out  a `SecretBlob`, so that its blocks are wiped. Where it has no room for as much it receives a block of
    ///     exactly that size
    /// \return false where the service refuses or memory is short
    virtual bool exportKey(Blob& out) = 0;

    virtual ~CrHash();
};

} // namespace ZOR_Basis

#endif
