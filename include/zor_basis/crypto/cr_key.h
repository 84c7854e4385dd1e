/// \file
/// `CrKey`: a key that encrypts and decrypts blobs. Made by `Crypt::deriveKey`.
///
/// Each call takes a complete message: nothing is carried over from one to the next. The same blob may be source and
/// target.
///
/// \thread  one thread at a time

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

    /// Encrypts a message; its size grows to the next multiple of 8, by at least one byte: 0 bytes give 8, and 8 give 16.
    /// \param out  where it has no room it receives a block of exactly the new size
    /// \kept crypto-04: a failed call leaves the plain message in `out`
    /// \error false for an invalid key; also, with `out` as it was, where memory is short and for a message of more than
    ///     4,294,967,287 bytes
    /// \cost one allocation at most
    virtual bool encrypt(Blob const& in, Blob& out) = 0;
    /// Decrypts a message and takes the padding away.
    /// \error false for an invalid key, for a message that is empty or not whole blocks of 8 bytes, and where the last
    ///     block does not end in a padding, as after most changes to it and with most other keys. `out` then has as many
    ///     bytes as `in`, and what they are is open. Also, with `out` as it was, where memory is short and for a message
    ///     of more than 4,294,967,288 bytes
    /// \cost one allocation at most
    virtual bool decrypt(Blob const& in, Blob& out) = 0;
    virtual bool isValid() const = 0;

    virtual ~CrKey();
};

} // namespace ZOR_Basis

#endif
