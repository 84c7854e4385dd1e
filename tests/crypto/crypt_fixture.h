/// \file
/// The fixture of the classes' tests: a user with a key; and a hash that counts destructions.

#ifndef TESTS_CRYPTO_CRYPT_FIXTURE_H
#define TESTS_CRYPTO_CRYPT_FIXTURE_H

#include "tests/crypto/crypt_user.h"

#include <gtest/gtest.h>

struct CryptFixture : testing::Test {
    CryptUser user;
    std::unique_ptr<ZOR_Basis::CrKey> key = user.key("secret");
};

struct MortalHash : ZOR_Basis::CrHash {
    explicit MortalHash(int& counter) : deaths(counter) {}
    ~MortalHash() override { ++deaths; }
    bool hashData(void const*, std::uint64_t) override { return true; }
    bool isValid() const override { return true; }
    bool exportKey(ZOR_Basis::Blob&) override { return false; }

    int& deaths;
};

#endif
