/// \file
/// Derives keys from secrets as a user does, and converts blobs to strings of bytes.

#ifndef TESTS_CRYPTO_CRYPT_USER_H
#define TESTS_CRYPTO_CRYPT_USER_H

#include <zor_basis/crypto.h>

#include <memory>
#include <string>

struct CryptUser {
    std::unique_ptr<ZOR_Basis::Crypt> crypt{ZOR_Basis::Crypt::make("user")};

    std::unique_ptr<ZOR_Basis::CrHash> hash(std::string const& secret) const {
        std::unique_ptr<ZOR_Basis::CrHash> made(crypt->createHash());
        made->hashData(secret.data(), secret.size());
        return made;
    }
    std::unique_ptr<ZOR_Basis::CrKey> key(std::string const& secret) const {
        return std::unique_ptr<ZOR_Basis::CrKey>(crypt->deriveKey(hash(secret).get()));
    }
};

inline std::string bytesOf(ZOR_Basis::Blob const& blob) {
    return blob.size() != 0 ? std::string(blob.val(), blob.size()) : std::string();
}

inline ZOR_Basis::Blob blobOf(std::string const& bytes) { return {bytes.size(), bytes.data()}; }

/// The encrypted message; empty if the key fails.
inline std::string encrypted(ZOR_Basis::CrKey& key, std::string const& plain) {
    ZOR_Basis::Blob out;
    return key.encrypt(blobOf(plain), out) ? bytesOf(out) : std::string();
}

#endif
