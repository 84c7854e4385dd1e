/// \file
/// `CrKey`: a key that encrypts and decrypts blobs. `Crypt::deriveKey` makes one.
///
/// Each call processes a complete message and keeps no state for the next. Source and target may be the same blob.
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_CRYPTO_CR_KEY_H
#define ZOR_BASIS_CRYPTO_CR_KEY_H

#include "zor_basis/export.h"
#include "zor_basis/store/blob.h"

namespace ZOR_Basis {

class ZB_API CrKey {
public:
    CrKey() = default;
    CrKey(CrKey const&) = default;
    CrKey& operator=(CrKey const&) = default;

    /// Encrypts a message; its size grows to the next multiple of 8, by at least one byte: 0 bytes give 8, and 8 give
    /// 16.
    /// \param out  receives the encrypted message; if it has too little room, it gets a block of exactly the new size
    /// \kept crypto-04: a call that fails leaves the plain message in `out`
    /// \error false for an invalid key; also, with `out` unchanged, if memory is short and for a message of more than
    ///     4,294,967,287 bytes
    /// \cost one allocation at most
    virtual bool encrypt(Blob const& in, Blob& out) = 0;
    /// Decrypts a message and removes the padding.
    /// \error false for an invalid key, for a message that is empty or not a multiple of 8 bytes, and if the last block
    ///     does not end in a valid padding, as after most changes to it and with most wrong keys. `out` then has as
    ///     many bytes as `in`, with unspecified values. Also false, with `out` unchanged, if memory is short and for a
    ///     message of more than 4,294,967,288 bytes
    /// \cost one allocation at most
    virtual bool decrypt(Blob const& in, Blob& out) = 0;
    virtual bool isValid() const = 0;

    virtual ~CrKey();
};

} // namespace ZOR_Basis

#endif
