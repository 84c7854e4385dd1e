// Any bytes as a message to encrypt and as an encrypted one. The first byte says how long the secret is.

#include "fuzz/target.h"

#include <zor_basis/crypto.h>
#include <zor_basis/text/blob.h>

#include <algorithm>
#include <cstdint>
#include <memory>

using namespace ZOR_Basis;

namespace {

Crypt& crypt() {
    static Crypt& made = *Crypt::make("");
    return made;
}

std::unique_ptr<CrKey> keyOf(unsigned char const* secret, std::size_t n) {
    CrHashPtr hash(&crypt());
    require(hash->hashData(secret, n));
    return std::unique_ptr<CrKey>(crypt().deriveKey(hash));
}

void runCrypt(unsigned char const* data, std::size_t size) {
    if (size == 0) return;
    std::size_t const secretSize = std::min<std::size_t>(data[0], size - 1);
    std::unique_ptr<CrKey> const key = keyOf(data + 1, secretSize);
    Blob const message(size - 1 - secretSize, reinterpret_cast<char const*>(data) + 1 + secretSize);

    Blob encrypted, back;
    require(key->encrypt(message, encrypted));
    require(encrypted.size() == message.size() / 8 * 8 + 8);
    require(key->decrypt(encrypted, back) && back == message);
    Blob same(message);
    require(key->encrypt(same, same) && same == encrypted);
    require(key->decrypt(same, same) && same == message);

    // What decrypts is what would be encrypted to the same bytes again.
    Blob plain;
    if (key->decrypt(message, plain)) {
        Blob again;
        require(key->encrypt(plain, again) && again == message);
    } else {
        require(plain == message || plain.size() == message.size());
    }
}

FuzzTarget const CRYPT("crypt", runCrypt);

} // namespace
